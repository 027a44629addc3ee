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

  /// The nickname when it is wanted and not empty, else first and last name.
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

/// How the board gets at the members: through one cursor that is opened at start-up and never asked again for
/// new rows. Each look moves it; the answers do not depend on where it goes afterwards.
class MemberLookup {
 public:
  MemberLookup(Recordset& rsMembers, MessageBoxes& boxes) : rsMembers_(rsMembers), boxes_(boxes) {}

  /// The member with this `ContactID`. When there is none, says so in a box.
  std::optional<Member> LoadMember(std::int32_t contactId);

  /// Throws RuntimeError 3021 when there is no such member (any more).
  MemberHistory LoadHistory(std::int32_t contactId);

  /// `ContactID` of the first member with this button, 0 when there is none.
  std::int32_t FindByDallasId(const std::string& dallasId);

 private:
  Recordset& rsMembers_;
  MessageBoxes& boxes_;
};
