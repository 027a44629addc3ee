#include "demo/MemberButtons.h"

#include <algorithm>
#include <array>
#include <cstdint>
#include <map>
#include <span>

#include "core/game/DallasId.h"
#include "sim/line/Crc.h"

namespace {

using Button = std::array<std::uint8_t, 8>;

constexpr std::size_t LeftAtHome = 2;

/// Guns with a button, in descending order of the damage they dealt.
std::vector<sim::GunScores> GunsWithButton(const std::vector<sim::GunScores>& game) {
  std::map<std::uint8_t, int> dealt;
  std::vector<sim::GunScores> guns;
  for (const sim::GunScores& gun : game) {
    for (const sim::Hit& hit : gun.Hits) {
      dealt[hit.Shooter] += hit.Amount;
    }
    if (gun.ButtonId != Button{}) {
      guns.push_back(gun);
    }
  }
  std::stable_sort(guns.begin(), guns.end(),
                   [&dealt](const sim::GunScores& left, const sim::GunScores& right) {
                     return dealt[left.PlayerId] > dealt[right.PlayerId];
                   });
  return guns;
}

/// A button of member `number`. In those of a game the fifth byte is a player id, never 0.
Button ButtonAtHome(std::size_t number) {
  constexpr std::uint8_t membershipFamily = 0x01;
  Button id{membershipFamily, static_cast<std::uint8_t>(number), 0x5C, 0xA7, 0, 0, 0, 0};
  id[7] = sim::Crc8(std::span(id).first<7>());
  return id;
}

}  // namespace

std::vector<std::string> MemberButtons(const std::vector<sim::GunScores>& game, std::size_t members) {
  const std::vector<sim::GunScores> guns = GunsWithButton(game);
  const std::size_t playing = std::min(guns.size(), members - std::min(members, LeftAtHome));
  std::vector<std::string> buttons;
  for (std::size_t member = 0; member < members; ++member) {
    buttons.push_back(DallasIdOf(member < playing ? guns[member].ButtonId : ButtonAtHome(member + 1)));
  }
  return buttons;
}
