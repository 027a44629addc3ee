#pragma once

#include <cstdint>
#include <optional>
#include <string>

#include "platform/Database.h"
#include "platform/MessageBoxes.h"

/// Who a member is.
struct Member {
  std::int32_t ContactId = 0;
  std::string FirstName;
  std::string LastName;
  std::string NickName;

  /// The nickname if `useNickName` and it is not empty, otherwise first and last name.
  std::string GetPlayerName(bool useNickName) const;
};

/// What a member has played so far.
struct MemberHistory {
  std::string Clan;
  double TotalGamesPlayed = 0;
  double AveragePrimAccuracy = 0;  ///< fraction, 1.0 = all shots hit
  double AverageDamage = 0;
  double AverageSoldiering = 0;
};

/// Finds members for the board, through one cursor that is opened at start-up and does not see rows added
/// later. Each call moves the cursor; the results do not depend on where it moves afterwards.
class MemberLookup {
 public:
  MemberLookup(Recordset& rsMembers, MessageBoxes& boxes) : rsMembers_(rsMembers), boxes_(boxes) {}

  /// The member with this `ContactID`. If there is none, a box says so.
  std::optional<Member> LoadMember(std::int32_t contactId);

  /// The nickname of the member with this `ContactID`, without a box: empty if there is none.
  std::string NickNameOf(std::int32_t contactId);

  /// Throws RuntimeError 3021 if the member does not exist (any more).
  MemberHistory LoadHistory(std::int32_t contactId);

  /// `ContactID` of the first member with this button, 0 if there is none.
  std::int32_t FindByDallasId(const std::string& dallasId);

 private:
  Recordset& rsMembers_;
  MessageBoxes& boxes_;
};
