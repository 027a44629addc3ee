#include "charts/ScoreParts.h"

#include <algorithm>
#include <cmath>
#include <numeric>

#include "core/game/SoldieringTerms.h"
#include "core/text/NumberForms.h"

namespace {

/// In hundredths. The bound keeps sums of them in range and is far beyond any score.
std::int64_t InHundredths(long double points) {
  constexpr long double most = 1e17L;
  return std::llround(std::clamp(points * 100, -most, most));
}

/// Damage that a player did.
struct DamageDone {
  std::int64_t ToOthers = 0;   ///< hits on one's own team too in a free-for-all
  std::int64_t ToOwnTeam = 0;  ///< before its factor
  std::int32_t Counted = 0;    ///< as it counts for the score
};

/// Throws RuntimeError 6 if it does not fit into 32 bits.
DamageDone DamageOf(int index, const ChartGame& game) {
  const int team = TeamFromId(IdFromIndex(index));
  DamageDone done;
  for (int victim = 1; victim <= PlayerCount; ++victim) {
    const std::int32_t hit = game.Game.Players(victim).HitByPlayer(index);
    const bool isOwnTeam = !game.FreeForAll && TeamFromId(IdFromIndex(victim)) == team;
    (isOwnTeam ? done.ToOwnTeam : done.ToOthers) += hit;
    // Rounded hit by hit, as scores are.
    const long double factor = isOwnTeam ? static_cast<long double>(game.Factors.FriendlyFire) : 1.0L;
    done.Counted = RoundToInt32(hit * factor + done.Counted);
  }
  return done;
}

/// The score that follows from the game's factors and mission. Throws RuntimeError 6 as DamageOf does.
std::int32_t ExpectedScore(const ChartGame& game, const ChartPlayer& who, SoldieringTerms terms,
                           std::int32_t damage) {
  terms.Damage = damage * static_cast<long double>(game.Factors.Damage);
  const std::int32_t score = RoundToInt32(terms.Sum());
  if (!game.PointsOfMission) {
    return score;
  }
  return WithPenalties(WithObjectivePoints(score, *game.PointsOfMission, game.Game.ObjectiveTeams,
                                           game.Game.TeamName(who.Index)),
                       *game.PointsOfMission, game.Game.Players(who.Index));
}

/// The parts but the last two, before any rounding.
std::array<long double, ScorePartCount> ExactParts(const ChartGame& game, const ChartPlayer& who,
                                                   const SoldieringTerms& terms, const DamageDone& damage) {
  using Wide = long double;
  const Player& player = game.Game.Players(who.Index);
  const MissionPoints mission = game.PointsOfMission.value_or(MissionPoints{});
  std::array<Wide, ScorePartCount> parts{};
  const auto of = [&parts](ScorePart part) -> Wide& { return parts[static_cast<std::size_t>(part)]; };
  of(ScorePart::Damage) = static_cast<Wide>(damage.ToOthers) * game.Factors.Damage;
  of(ScorePart::OwnTeam) =
      static_cast<Wide>(damage.ToOwnTeam) * game.Factors.FriendlyFire * game.Factors.Damage;
  of(ScorePart::Accuracy) = terms.Accuracy;
  of(ScorePart::Deaths) = terms.Death;
  of(ScorePart::Heals) = terms.Heal;
  of(ScorePart::AmmoAdds) = terms.Ammo;
  of(ScorePart::Bonus) = terms.Bonus;
  of(ScorePart::Objectives) =
      ObjectivePointsOf(mission, game.Game.ObjectiveTeams, game.Game.TeamName(who.Index));
  of(ScorePart::RespawnPenalty) = -Wide{mission.RespawnPenalty} * player.RespawnCount;
  of(ScorePart::HealPenalty) = -Wide{mission.HealPenalty} * player.HealCount;
  return parts;
}

PlayerParts PartsOf(const ChartPlayer& who, const ChartGame& game) {
  const Player& player = game.Game.Players(who.Index);
  const SoldieringTerms terms = SoldieringTermsOf(player, game.Factors);
  DamageDone damage;
  std::optional<std::int32_t> expected;
  try {
    damage = DamageOf(who.Index, game);
    expected = ExpectedScore(game, who, terms, damage.Counted);
  } catch (const RuntimeError&) {
    expected.reset();  // no score can have been made so
  }
  PlayerParts parts{
      .Player = who, .Team = TeamFromId(IdFromIndex(who.Index)), .Soldiering = player.Soldiering};
  const std::array<long double, ScorePartCount> exact = ExactParts(game, who, terms, damage);
  std::transform(exact.begin(), exact.end(), parts.Hundredths.begin(), InHundredths);
  const std::int64_t sum = std::accumulate(parts.Hundredths.begin(), parts.Hundredths.end(), std::int64_t{});
  const std::int64_t made = expected ? *expected * std::int64_t{100} : sum;
  parts.Hundredths[static_cast<std::size_t>(ScorePart::Rounding)] = made - sum;
  parts.Hundredths[static_cast<std::size_t>(ScorePart::Other)] = parts.Soldiering * std::int64_t{100} - made;
  return parts;
}

}  // namespace

std::vector<PlayerParts> ScorePartsOf(const ChartGame& game) {
  std::vector<PlayerParts> players;
  players.reserve(game.Players.size());
  for (const ChartPlayer& player : game.Players) {
    players.push_back(PartsOf(player, game));
  }
  std::sort(players.begin(), players.end(), [](const PlayerParts& left, const PlayerParts& right) {
    return left.Soldiering != right.Soldiering ? left.Soldiering > right.Soldiering
                                               : left.Player.Index < right.Player.Index;
  });
  return players;
}

std::vector<ScorePart> PartsInUse(const std::vector<PlayerParts>& players) {
  std::vector<ScorePart> parts;
  for (int part = 0; part < ScorePartCount; ++part) {
    const auto which = static_cast<ScorePart>(part);
    if (std::any_of(players.begin(), players.end(),
                    [which](const PlayerParts& player) { return player.Of(which) != 0; })) {
      parts.push_back(which);
    }
  }
  return parts;
}

std::string PointsText(std::int64_t hundredths) {
  const bool negative = hundredths < 0;
  const std::int64_t amount = std::abs(hundredths);
  std::string text = (negative ? "-" : "") + std::to_string(amount / 100);
  if (const std::int64_t rest = amount % 100; rest != 0) {
    text += '.';
    text += std::to_string(rest / 10);
    if (rest % 10 != 0) {
      text += std::to_string(rest % 10);
    }
  }
  return text;
}
