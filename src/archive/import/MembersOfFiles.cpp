#include "archive/import/MembersOfFiles.h"

#include "core/game/IsButton.h"
#include "platform/Sql.h"

void MembersOfFiles::Settle(Game& game) {
  if (table_ == FilesOf::ThisTable) {
    return;
  }
  const ReadScope scope(members_);
  for (Player& player : game.Players) {
    if (!player.Active) {
      continue;
    }
    const bool hasButton = IsButton(player.DallasID);
    if (!hasButton) {
      player.MemberIndex = 0;
    } else if (player.MemberIndex == 0 || !Has(player.MemberIndex, player.DallasID)) {
      player.MemberIndex = OwnerOf(player.DallasID);
    }
  }
}

bool MembersOfFiles::Has(std::int32_t number, const std::string& button) {
  return WholeNumber(members_.Statements(),
                     "SELECT count(*) FROM Members WHERE ContactID = $1 AND DallasID = $2",
                     {std::int64_t{number}, button}) != 0;
}

std::int32_t MembersOfFiles::OwnerOf(const std::string& button) {
  const auto known = owners_.find(button);
  if (known != owners_.end()) {
    return known->second;
  }
  const auto owner = static_cast<std::int32_t>(
      WholeNumber(members_.Statements(), "SELECT min(ContactID) FROM Members WHERE DallasID = $1", {button}));
  owners_.emplace(button, owner);
  return owner;
}
