#include "sim/game/GameMaker.h"

#include <algorithm>
#include <array>
#include <cstddef>
#include <random>
#include <span>
#include <stdexcept>
#include <utility>

#include "sim/line/Crc.h"

namespace sim {
namespace {

constexpr int MostPlayers = 224;
constexpr std::size_t GunsOfThirdTeam = 32;

// The standard defines the output of mt19937 but not that of its distributions or of std::shuffle, and a seed
// must give the same game on every machine.
class Dice {
 public:
  explicit Dice(std::uint32_t seed) : engine_(seed) {}

  int Between(int low, int high) {
    const std::uint64_t range = static_cast<std::uint64_t>(high - low) + 1;
    return low + static_cast<int>((std::uint64_t{engine_()} * range) >> 32U);
  }
  std::uint16_t Word(int low, int high) { return static_cast<std::uint16_t>(Between(low, high)); }
  bool Chance(int percent) { return Between(1, 100) <= percent; }
  template <class T>
  T& OneOf(std::vector<T>& items) {
    return items[static_cast<std::size_t>(Between(0, static_cast<int>(items.size()) - 1))];
  }
  template <class T>
  void Shuffle(std::vector<T>& items) {
    for (std::size_t i = items.size(); i > 1; --i) {
      std::swap(items[i - 1], items[static_cast<std::size_t>(Between(0, static_cast<int>(i) - 1))]);
    }
  }

 private:
  std::mt19937 engine_;
};

struct Gun {
  std::uint8_t PlayerId;
  std::size_t Team;  // 0 to 2
};

std::vector<Gun> AllGunsOf(std::size_t team) {
  // The top three bits of a player id (1 to 7) select a block of 32 guns.
  constexpr std::array<std::size_t, 7> teamOfBlock{0, 1, 2, 0, 0, 1, 1};
  std::vector<Gun> guns;
  for (std::size_t id = 32; id < 256; ++id) {
    if (teamOfBlock[id / 32 - 1] == team) {
      guns.push_back({static_cast<std::uint8_t>(id), team});
    }
  }
  return guns;
}

std::vector<Gun> DrawGuns(std::size_t players, Dice& dice) {
  const std::size_t third = std::min(players / 3, GunsOfThirdTeam);
  const std::size_t second = (players - third) / 2;
  const std::array<std::size_t, 3> sizes{players - third - second, second, third};
  std::vector<Gun> drawn;
  for (std::size_t team = 0; team < sizes.size(); ++team) {
    std::vector<Gun> guns = AllGunsOf(team);
    dice.Shuffle(guns);
    guns.resize(sizes[team]);
    drawn.insert(drawn.end(), guns.begin(), guns.end());
  }
  dice.Shuffle(drawn);
  return drawn;
}

// The player id in the serial number makes button ids unique within a game.
std::array<std::uint8_t, 8> DrawButton(std::uint8_t playerId, Dice& dice) {
  constexpr std::uint8_t membershipFamily = 0x01;
  std::array<std::uint8_t, 8> id{membershipFamily, 0, 0, 0, playerId, 0, 0, 0};
  for (std::size_t i = 1; i <= 3; ++i) {
    id[i] = static_cast<std::uint8_t>(dice.Between(0, 255));
  }
  id[7] = Crc8(std::span(id).first<7>());
  return id;
}

GunScores DrawGun(const Gun& gun, int gameMinutes, Dice& dice) {
  GunScores scores;
  scores.PlayerId = gun.PlayerId;
  const bool neverFired = dice.Chance(2);
  scores.ShotCount = neverFired ? std::uint16_t{0} : dice.Word(50, 900);
  scores.AmmoAddCount = static_cast<std::uint16_t>(scores.ShotCount / dice.Between(90, 150));
  scores.AdminKillCount = dice.Chance(4) ? dice.Word(1, 2) : std::uint16_t{0};
  scores.ExplosiveDamage =
      dice.Chance(25) ? static_cast<std::uint16_t>(50 * dice.Between(1, 6)) : std::uint16_t{0};
  scores.RadiationDamage = dice.Chance(12) ? dice.Word(1, 40) : std::uint16_t{0};
  scores.StunCount = dice.Chance(20) ? dice.Word(1, 6) : std::uint16_t{0};
  if (dice.Chance(67)) {
    scores.ButtonId = DrawButton(gun.PlayerId, dice);
  }
  scores.RemainingClips = dice.Word(0, 8);
  scores.RemainingAmmo = dice.Word(0, 30);
  scores.SecondaryDamage =
      dice.Chance(40) ? static_cast<std::uint16_t>(25 * dice.Between(2, 6)) : std::uint16_t{0};
  scores.PrimaryDamage = static_cast<std::uint16_t>(5 * dice.Between(2, 8));
  scores.RunCounter = static_cast<std::uint16_t>(gameMinutes + dice.Between(0, 3));
  scores.PowerCheatFlag = dice.Chance(3) ? std::uint8_t{1} : std::uint8_t{0};
  return scores;
}

// Damage points by player hit (row) and shooter (column).
using DamageTable = std::vector<std::vector<int>>;

struct Targets {
  std::vector<std::size_t> Friends;
  std::vector<std::size_t> Foes;
};

Targets TargetsOf(std::size_t shooter, const std::vector<Gun>& guns) {
  Targets targets;
  for (std::size_t other = 0; other < guns.size(); ++other) {
    if (other != shooter) {
      (guns[other].Team == guns[shooter].Team ? targets.Friends : targets.Foes).push_back(other);
    }
  }
  return targets;
}

// Hits come in bursts: several in a row on the same target.
void PlayBursts(std::size_t shooter, const std::vector<Gun>& guns, const GunScores& scores,
                DamageTable& damage, Dice& dice) {
  Targets targets = TargetsOf(shooter, guns);
  int hitsLeft = scores.ShotCount * dice.Between(5, 45) / 100;
  while (hitsLeft > 0) {
    const int burst = std::min(hitsLeft, dice.Between(1, 6));
    hitsLeft -= burst;
    const bool secondaryWeapon = scores.SecondaryDamage > 0 && dice.Chance(4);
    const int points = secondaryWeapon ? scores.SecondaryDamage : burst * scores.PrimaryDamage;
    const int aim = dice.Between(1, 1000);
    if (aim <= 4) {
      damage[shooter][shooter] += points;
      continue;
    }
    std::vector<std::size_t>& seen = aim <= 50 ? targets.Friends : targets.Foes;
    if (!seen.empty()) {
      damage[dice.OneOf(seen)][shooter] += points;
    }
  }
}

void TellHits(const std::vector<int>& taken, const std::vector<Gun>& guns, GunScores& scores, Dice& dice) {
  constexpr int mostPoints = 0x7FFF;
  constexpr int pointsOfALife = 250;
  int total = scores.ExplosiveDamage + scores.RadiationDamage;
  for (std::size_t shooter = 0; shooter < guns.size(); ++shooter) {
    if (taken[shooter] > 0) {
      const int amount = std::min(taken[shooter], mostPoints);
      scores.Hits.push_back({guns[shooter].PlayerId, static_cast<std::uint16_t>(amount)});
      total += amount;
    }
  }
  const int deaths = std::min(total / pointsOfALife, 999);
  const bool deadAtTheEnd = deaths > 0 && dice.Chance(30);
  scores.DeathCount = static_cast<std::uint16_t>(deaths + scores.AdminKillCount);
  scores.RespawnCount = static_cast<std::uint16_t>(scores.DeathCount - (deadAtTheEnd ? 1 : 0));
  scores.HealCount = dice.Word(0, deaths / 2 + 2);
  scores.RemainingHealth = deadAtTheEnd ? std::uint16_t{0} : dice.Word(1, 100);
}

}  // namespace

std::vector<GunScores> MakeGame(int players, std::uint32_t seed) {
  if (players < 0 || players > MostPlayers) {
    throw std::invalid_argument("A game has 0 to 224 players");
  }
  Dice dice(seed);
  const std::vector<Gun> guns = DrawGuns(static_cast<std::size_t>(players), dice);
  const int gameMinutes = dice.Between(12, 35);
  std::vector<GunScores> game;
  game.reserve(guns.size());
  for (const Gun& gun : guns) {
    game.push_back(DrawGun(gun, gameMinutes, dice));
  }
  DamageTable damage(guns.size(), std::vector<int>(guns.size(), 0));
  for (std::size_t shooter = 0; shooter < guns.size(); ++shooter) {
    PlayBursts(shooter, guns, game[shooter], damage, dice);
  }
  for (std::size_t victim = 0; victim < guns.size(); ++victim) {
    TellHits(damage[victim], guns, game[victim], dice);
  }
  return game;
}

}  // namespace sim
