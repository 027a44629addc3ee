#pragma once

#include <cstdint>
#include <memory>
#include <string>

#include "members/MemberDetails.h"
#include "platform/Database.h"

/// The controls in which the operator sees and edits a row.
class BoundControls {
 public:
  /// Shows the current row of `rows`. Throws RuntimeError when it cannot be read.
  virtual void ShowRow(Recordset& rows) = 0;
  /// Clears and disables the controls, as there is no current row.
  virtual void ShowNoRow() = 0;
  /// The current contents of the controls.
  virtual MemberDetails Entered() const = 0;
  /// Called whenever another row, or none, has become the current one.
  virtual void RowChanged() = 0;

 protected:
  ~BoundControls() = default;
};

/// A separate cursor on the members, with controls bound to it: they show the current row, and changes made
/// in them are written back when the cursor leaves the row or its source is reloaded.
///
/// All operations throw RuntimeError if the database fails. A change that could not be written stays in the
/// controls, and the cursor on its row; it is discarded only if the row no longer exists.
class MemberCursor {
 public:
  MemberCursor(Database& dbMembers, BoundControls& controls);

  /// Reads the rows of a query and shows the first one. If the query fails, keeps the old rows.
  void Refresh(const std::string& recordSource);

  /// Move like the arrows of a data control, and stop at the first and the last row.
  void MoveFirst();
  void MovePrevious();
  void MoveNext();
  void MoveLast();

  /// Moves to the member with this ContactID, or past the last row if there is none.
  void WalkTo(std::int64_t contactId);

  /// Adds a member with join date `now` and a placeholder for the name, and shows it.
  void AddMember(const std::string& now);

  /// Deletes the current row and shows the first one.
  void Delete();

  /// Writes the changes made to the current row.
  void WriteBack();

  /// Writes one column of the current row immediately.
  void SetField(const std::string& column, const std::string& text);

  /// How many changed rows were written back so far.
  int WrittenBack() const { return writtenBack_; }

  /// True if a row is shown.
  bool HasRow() const { return hasRow_; }

  Recordset& Rows() { return *rows_; }

 private:
  void Show();
  void Update();

  Database& dbMembers_;
  BoundControls& controls_;
  std::unique_ptr<Recordset> rows_;
  bool hasRow_ = false;
  int writtenBack_ = 0;
  MemberDetails shown_;  ///< the controls' contents when the row was last shown or written
};
