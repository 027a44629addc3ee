#include "core/game/HitLines.h"

#include <optional>
#include <utility>

#include "core/text/NumberForms.h"

namespace {

void AddLine(std::vector<HitLine>& lines, int index, std::int32_t amount, const Game& game,
             MemberLookup& members) {
  if (amount <= 0) {
    return;
  }
  std::string text = game.DisplayName(index) + ": " + Str(amount);
  if (const std::int32_t contactId = game.Players(index).MemberIndex; contactId != 0) {
    if (const std::optional<Member> member = members.LoadMember(contactId)) {
      text += "  (" + member->GetPlayerName(false) + ")";
    }
  }
  lines.push_back({std::move(text), index, amount});
}

}  // namespace

std::vector<HitLine> HitsGivenBy(int index, const Game& game, MemberLookup& members) {
  std::vector<HitLine> lines;
  for (int victim = 1; victim <= PlayerCount; ++victim) {
    AddLine(lines, victim, game.Players(victim).HitByPlayer(index), game, members);
  }
  return lines;
}

std::vector<HitLine> HitsTakenBy(int index, const Game& game, MemberLookup& members) {
  std::vector<HitLine> lines;
  for (int shooter = 1; shooter <= PlayerCount; ++shooter) {
    AddLine(lines, shooter, game.Players(index).HitByPlayer(shooter), game, members);
  }
  return lines;
}

std::vector<std::string> SpecialDamageOf(const Player& player) {
  std::vector<std::string> lines;
  for (const auto& [caption, amount] : {std::pair{"Explosive: ", player.ExplosiveDamage},
                                        {"Radiation: ", player.RadiationDamage},
                                        {"Stuns: ", player.StunCount}}) {
    if (amount > 0) {
      lines.push_back(caption + std::to_string(amount));
    }
  }
  return lines;
}

std::string RunTimeText(std::int32_t minutes) {
  const std::int32_t hours = minutes / 60;
  return Str(hours) + "H " + Str(minutes - hours * 60) + "M";
}
