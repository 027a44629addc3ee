#pragma once

#include <cstdint>
#include <string>

#include "platform/Database.h"
#include "platform/MessageBoxes.h"

/// How the board gets at the members: through one cursor that is opened at start-up and never asked again for
/// new rows.
class MemberLookup {
 public:
  MemberLookup(Recordset& rsMembers, MessageBoxes& boxes) : rsMembers_(rsMembers), boxes_(boxes) {}

  /// Moves to the member with this `ContactID`. When there is none, says so in a box and returns false.
  bool LoadMember(std::int32_t contactId);

  /// `ContactID` of the first member with this button, 0 when there is none.
  std::int32_t FindByDallasId(const std::string& dallasId);

  /// Name of the current member: the nickname when it is wanted and not empty, else first and last name.
  std::string GetPlayerName(bool useNickName);

 private:
  Recordset& rsMembers_;
  MessageBoxes& boxes_;
};
