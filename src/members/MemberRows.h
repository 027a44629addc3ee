#pragma once

#include <cstdint>
#include <memory>
#include <string>

#include "members/MemberDetails.h"
#include "platform/Database.h"

/// The controls that show a row and into which the operator writes.
class BoundControls {
 public:
  /// Shows the current row of `rows`. Throws RuntimeError when it cannot be read.
  virtual void ShowRow(Recordset& rows) = 0;
  /// There is no row: shows that nothing can be entered.
  virtual void ShowNoRow() = 0;
  /// What the controls hold now.
  virtual MemberDetails Entered() const = 0;
  /// Runs after every change of the current row, also to none.
  virtual void RowChanged() = 0;

 protected:
  ~BoundControls() = default;
};

/// A cursor of its own on the members, with controls bound to it: they show the row on which it stands, and
/// what was changed in them is written back when it leaves the row and when its source is read anew.
///
/// All operations throw RuntimeError when the database fails. A change that could not be written stays in the
/// controls and the cursor on its row; only when the row itself is gone is the change given up.
class MemberRows {
 public:
  MemberRows(Database& dbMembers, BoundControls& controls);

  /// Reads the rows of a query and shows the first one. When the query fails the old rows stay.
  void Refresh(const std::string& recordSource);

  /// As the arrows of a data control: before the first row and behind the last one they stop.
  void MoveFirst();
  void MovePrevious();
  void MoveNext();
  void MoveLast();

  /// Moves to the member with this number, behind the last row when there is none.
  void WalkTo(std::int64_t contactId);

  /// Adds a member who joined `now` and has no name yet, and shows it.
  void AddMember(const std::string& now);

  /// Deletes the current row and shows the first one.
  void Delete();

  /// Writes the changes of the current row.
  void WriteBack();

  /// Writes one column of the current row at once.
  void SetField(const std::string& column, const std::string& text);

  /// True on a row that is shown.
  bool HasRow() const { return hasRow_; }

  Recordset& Rows() { return *rows_; }

 private:
  void Show();
  void Update();

  Database& dbMembers_;
  BoundControls& controls_;
  std::unique_ptr<Recordset> rows_;
  bool hasRow_ = false;
  MemberDetails shown_;  ///< what the controls held when the row had been shown or written
};
