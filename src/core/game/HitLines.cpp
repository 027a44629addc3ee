#include "core/game/HitLines.h"

#include <optional>

#include "core/text/NumberForms.h"

namespace {

void AddHit(std::vector<Hit>& hits, int index, std::int32_t amount) {
  if (amount > 0) {
    hits.push_back({index, amount});
  }
}

}  // namespace

std::vector<Hit> HitsGivenBy(int index, const Game& game) {
  std::vector<Hit> hits;
  for (int victim = 1; victim <= PlayerCount; ++victim) {
    AddHit(hits, victim, game.Players(victim).HitByPlayer(index));
  }
  return hits;
}

std::vector<Hit> HitsTakenBy(int index, const Game& game) {
  std::vector<Hit> hits;
  for (int shooter = 1; shooter <= PlayerCount; ++shooter) {
    AddHit(hits, shooter, game.Players(index).HitByPlayer(shooter));
  }
  return hits;
}

std::string HitText(const std::string& playerName, const Hit& hit, const Game& game, MemberLookup& members,
                    bool useNickName) {
  std::string text = playerName + ": " + Str(hit.Amount);
  if (const std::int32_t contactId = game.Players(hit.Index).MemberIndex; contactId != 0) {
    if (const std::optional<Member> member = members.LoadMember(contactId)) {
      text += "  (" + member->GetPlayerName(useNickName) + ")";
    }
  }
  return text;
}

std::vector<SpecialHit> SpecialHitsOf(const Player& player) {
  std::vector<SpecialHit> hits;
  for (const SpecialHit& hit :
       {SpecialHit{"Explosive: ", player.ExplosiveDamage}, SpecialHit{"Radiation: ", player.RadiationDamage},
        SpecialHit{"Stuns: ", player.StunCount}}) {
    if (hit.Amount > 0) {
      hits.push_back(hit);
    }
  }
  return hits;
}

std::vector<std::string> SpecialDamageOf(const Player& player) {
  std::vector<std::string> lines;
  for (const SpecialHit& hit : SpecialHitsOf(player)) {
    lines.push_back(hit.Caption + std::to_string(hit.Amount));
  }
  return lines;
}
