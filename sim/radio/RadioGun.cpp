#include "sim/radio/RadioGun.h"

#include <algorithm>
#include <array>

#include "sim/game/ScoreFrame.h"

namespace sim {
namespace {

// Every code that has a name; 27 consecutive player ids show each once.
constexpr std::array<std::uint8_t, 27> Weapons{0,  1,  2,  3,  4,   5,   6,   7,   8,   9,   10,  11,  12, 13,
                                               14, 15, 16, 17, 100, 101, 102, 103, 104, 105, 106, 107, 108};
// The radios' addresses begin with the manufacturer's part. The 0x7E in the serial number looks like a start
// byte but is data.
constexpr std::uint64_t AddressBase = 0x0013A200'407E0000;

}  // namespace

std::vector<RadioGun> MakeRadioGuns(const std::vector<GunScores>& game,
                                    std::chrono::microseconds answerTime) {
  std::vector<RadioGun> guns;
  guns.reserve(game.size());
  for (const GunScores& scores : game) {
    const unsigned id = scores.PlayerId;
    RadioGun gun;
    gun.PlayerId = scores.PlayerId;
    gun.Address = AddressBase + std::uint64_t{id} * 151U % 256U * 256U + id;
    gun.FirmwareMajor = id % 16 == 0 ? 1 : 2;
    gun.FirmwareMinor = static_cast<std::uint8_t>(id % 3 + 9);
    gun.Battery = static_cast<std::uint8_t>(100 - id * 37U % 91U);
    gun.Weapon = Weapons.at(id % Weapons.size());
    gun.Frame = EncodeScoreFrame(scores);
    gun.AnswerTime = answerTime;
    guns.push_back(gun);
  }
  std::sort(guns.begin(), guns.end(),
            [](const RadioGun& left, const RadioGun& right) { return left.PlayerId < right.PlayerId; });
  return guns;
}

}  // namespace sim
