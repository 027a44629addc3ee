#include "core/game/PlayerId.h"

#include "core/text/NumberForms.h"
#include "platform/RuntimeError.h"

namespace {

constexpr int FirstTeamNameText = 114;

}  // namespace

std::int16_t PlayerNumberFromId(std::uint8_t id) {
  const auto inBlock = static_cast<std::int16_t>(id & 31);
  switch (id & 224) {
    case 0:
      return 0;
    case 128:
    case 192:
      return static_cast<std::int16_t>(inBlock + 32);
    case 160:
    case 224:
      return static_cast<std::int16_t>(inBlock + 64);
    default:
      return inBlock;
  }
}

std::int16_t TeamFromId(std::uint8_t id) {
  switch (id & 224) {
    case 64:
    case 192:
    case 224:
      return 2;
    case 96:
      return 3;
    default:
      return 1;
  }
}

std::int16_t MaxPlayerNumber(std::int16_t team) {
  return team == 3 ? 31 : 95;
}

std::uint8_t IdFromTeamAndNumber(std::uint8_t team, std::uint8_t number) {
  const bool firstBlock = number < 32;
  int id = 0;
  if (team == 1) {
    id = number + (firstBlock ? 32 : 96);
  } else if (team == 2) {
    id = number + (firstBlock ? 64 : 160);
  } else if (team == 3 && firstBlock) {
    id = number + 96;
  }
  if (id > 255) {
    throw RuntimeError(Fault::Overflow);
  }
  return static_cast<std::uint8_t>(id);
}

std::string TeamNameFromNumber(const StringTable& texts, std::int16_t team) {
  return team >= 1 && team <= TeamCount ? texts.Text(FirstTeamNameText + team - 1) : std::string();
}

std::string PlayerName(std::string_view teamName, std::uint8_t id) {
  std::string name(teamName);
  name += ' ';
  name += Str(std::int32_t{PlayerNumberFromId(id)});
  return name;
}

std::int16_t TeamNumberFromName(const StringTable& texts, std::string_view name) {
  for (std::int16_t team = 1; team <= TeamCount; ++team) {
    if (texts.Text(FirstTeamNameText + team - 1) == name) {
      return team;
    }
  }
  return 0;
}
