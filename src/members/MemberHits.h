#pragma once

#include <cstdint>
#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "platform/Database.h"

/// What the list of members shows of one of them.
struct MemberHit {
  std::int64_t ContactId = 0;
  std::string FirstName;
  std::string LastName;
  std::string NickName;
  std::string LastPlayed;  ///< "YYYY-MM-DD HH:MM:SS", empty before the first game
  bool HasPhoto = false;

  std::string Name() const { return FirstName + " " + LastName; }
};

/// The numbers of all members that Search finds for `text`, however many. Throws RuntimeError as Sql does.
std::vector<std::int32_t> MembersCalled(Database& dbMembers, const std::string& text);

/// The members found for the text in the search box, in table order, through a cursor of their own that never
/// writes. Nothing here throws for a fault of the database, since this is looked up while the operator types:
/// what cannot be read is missing, and so is everything after a fault of the file until the next search.
class MemberHits {
 public:
  /// `dbMembers` must outlive this object.
  explicit MemberHits(Database& dbMembers) : dbMembers_(dbMembers) {}

  /// Finds the members with a first name, last name or nickname that begins with `text`; all for an empty
  /// one. A pattern that is not complete, such as an open bracket, finds none.
  void Search(const std::string& text);

  int Count() const { return rows_ ? rows_->RecordCount() : 0; }

  /// The member at `position`, counted from 0; nullopt if the row is gone.
  std::optional<MemberHit> At(int position);

  /// Position of this member, or -1 if it was not found.
  int PositionOf(std::int64_t contactId);

  /// True if another member has the same first and last name. By that the window's OK looks for its member.
  bool SharesName(const MemberHit& hit);

  /// The photo of the member at `position` as it is stored; empty if there is none.
  std::string Photo(int position);

 private:
  /// The result of an operation on the rows, or `missing` if it fails.
  template <typename Result, typename Operation>
  Result Try(Result missing, const Operation& operation);

  Database& dbMembers_;
  std::unique_ptr<Recordset> rows_;
};
