#include "core/game/MemberLookup.h"

#include "core/data/FieldValue.h"
#include "core/text/NumberForms.h"

bool MemberLookup::LoadMember(std::int32_t contactId) {
  if (rsMembers_.WalkTo("ContactID", std::int64_t{contactId})) {
    return true;
  }
  boxes_.Show("Could not locate specified Member in database!", "Member Error", BoxIcon::Exclamation);
  return false;
}

std::int32_t MemberLookup::FindByDallasId(const std::string& dallasId) {
  if (!rsMembers_.WalkTo("DallasID", dallasId)) {
    return 0;
  }
  const std::int32_t contactId = RoundToInt32(NumberOf(rsMembers_.Fields("ContactID")));
  rsMembers_.MoveNext();
  return contactId;
}

std::string MemberLookup::GetPlayerName(bool useNickName) {
  if (useNickName) {
    std::string nickName = TextOf(rsMembers_.Fields("NickName"));
    if (!nickName.empty()) {
      return nickName;
    }
  }
  return TextOf(rsMembers_.Fields("FirstName")) + " " + TextOf(rsMembers_.Fields("LastName"));
}
