#include "core/game/MemberLookup.h"

#include "core/data/FieldValue.h"
#include "core/text/NumberForms.h"

std::string Member::GetPlayerName(bool useNickName) const {
  return useNickName && !NickName.empty() ? NickName : FirstName + " " + LastName;
}

std::optional<Member> MemberLookup::LoadMember(std::int32_t contactId) {
  if (!rsMembers_.WalkTo("ContactID", std::int64_t{contactId})) {
    boxes_.Show("Could not locate specified Member in database!", "Member Error", BoxIcon::Exclamation);
    return std::nullopt;
  }
  const auto text = [this](const char* column) { return TextOf(rsMembers_.Fields(column)); };
  return Member{contactId, text("FirstName"), text("LastName"), text("NickName")};
}

std::string MemberLookup::NickNameOf(std::int32_t contactId) {
  return rsMembers_.WalkTo("ContactID", std::int64_t{contactId}) ? TextOf(rsMembers_.Fields("NickName")) : "";
}

MemberHistory MemberLookup::LoadHistory(std::int32_t contactId) {
  rsMembers_.WalkTo("ContactID", std::int64_t{contactId});
  const auto number = [this](const char* column) { return NumberOf(rsMembers_.Fields(column)); };
  return {TextOf(rsMembers_.Fields("Clan")), number("TotalGamesPlayed"), number("AveragePrimAccuracy"),
          number("AverageDamage"), number("AverageSoldiering")};
}

std::int32_t MemberLookup::FindByDallasId(const std::string& dallasId) {
  if (!rsMembers_.WalkTo("DallasID", dallasId)) {
    return 0;
  }
  const std::int32_t contactId = RoundToInt32(NumberOf(rsMembers_.Fields("ContactID")));
  rsMembers_.MoveNext();
  return contactId;
}
