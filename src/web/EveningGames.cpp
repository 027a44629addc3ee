#include "web/EveningGames.h"

#include <algorithm>

#include "core/game/WordDigest.h"

namespace {

/// What the gun itself noted in the game; 0 for one that noted nothing.
std::uint64_t MarkOf(const Player& player) {
  WordDigest digest;
  std::int64_t sum = 0;
  const auto add = [&](std::int32_t figure) {
    digest.Add(figure);
    sum += figure != 0 ? 1 : 0;
  };
  for (const std::int32_t figure :
       {player.ShotCount, player.HealCount, player.AmmoAddCount, player.AdminKillCount, player.RespawnCount,
        player.DeathCount, player.ExplosiveDamage, player.RadiationDamage, player.StunCount}) {
    add(figure);
  }
  for (const std::int32_t damage : player.HitByPlayer) {
    add(damage);
  }
  return sum > 0 ? digest.Value() : 0;
}

std::map<int, std::uint64_t> MarksOf(const Game& game) {
  std::map<int, std::uint64_t> marks;
  for (int index = 1; index <= PlayerCount; ++index) {
    if (game.Players(index).Active) {
      if (const std::uint64_t mark = MarkOf(game.Players(index)); mark != 0) {
        marks[index] = mark;
      }
    }
  }
  return marks;
}

/// True if the guns of one are among those of the other, and noted the same there.
bool AreOneGame(const std::map<int, std::uint64_t>& one, const std::map<int, std::uint64_t>& other) {
  const auto& fewer = one.size() <= other.size() ? one : other;
  const auto& more = one.size() <= other.size() ? other : one;
  return !fewer.empty() && std::ranges::all_of(fewer, [&more](const auto& gun) {
    const auto found = more.find(gun.first);
    return found != more.end() && found->second == gun.second;
  });
}

}  // namespace

PublicGame PublicGameOf(const EveningGame& game,
                        const std::function<std::string(const NameHolder&)>& nameShown) {
  PublicGame shown = game.Figures;
  for (std::size_t at = 0; at < shown.Players.size(); ++at) {
    shown.Players[at].Name = nameShown(game.Holders.at(at));
  }
  return shown;
}

EveningGame EveningGames::GameOf(const Scored& scored) {
  EveningGame game{.Figures = PublicGameOf(scored.Game, 0, scored.Time, ShownNames())};
  game.Holders.reserve(game.Figures.Players.size());
  for (const PublicPlayer& player : game.Figures.Players) {
    game.Holders.push_back(HolderOf(scored.Game, player.Gun, scored.OfMembers, scored.OfGuests));
  }
  game.Marks = MarksOf(scored.Game);
  game.Since = scored.Played;
  return game;
}

int EveningGames::TakeEarlier(const Scored& scored) {
  EveningGame game = GameOf(scored);
  if (game.Figures.Players.empty()) {
    return 0;
  }
  const int known = NumberOf(game.Marks);
  const int number = known != 0 ? known : ++last_;
  game.Figures.Number = number;
  game.IsPublic = true;
  games_.insert_or_assign(number, std::move(game));
  return number;
}

bool EveningGames::Take(const Scored& scored) {
  EveningGame game = GameOf(scored);
  if (game.Figures.Players.empty()) {
    return false;
  }
  if (onBoard_ == 0 || !games_.contains(onBoard_)) {
    onBoard_ = NumberOf(game.Marks);
  }
  if (onBoard_ == 0) {
    onBoard_ = ++last_;
  }
  game.Figures.Number = onBoard_;
  if (const auto before = games_.find(onBoard_); before != games_.end()) {
    game.Since = before->second.Since;
    game.Figures.Time = before->second.Figures.Time;
    game.IsPublic = before->second.IsPublic;
    const bool isSame = game.Figures == before->second.Figures && game.Holders == before->second.Holders;
    before->second = std::move(game);
    return !isSame;
  }
  games_.emplace(onBoard_, std::move(game));
  return true;
}

int EveningGames::NumberOf(const std::map<int, std::uint64_t>& marks) const {
  const auto found = std::ranges::find_if(
      games_, [&marks](const auto& game) { return AreOneGame(marks, game.second.Marks); });
  return found != games_.end() ? found->first : 0;
}

void EveningGames::Prune(std::chrono::microseconds now) {
  std::erase_if(games_, [now](const auto& game) { return now - game.second.Since >= Age; });
  while (games_.size() > Most) {
    games_.erase(games_.begin());
  }
}

void EveningGames::NameAnew(const NickNames& ofMembers) {
  for (auto& [number, game] : games_) {
    for (NameHolder& holder : game.Holders) {
      if (holder.Member != 0) {
        holder.NickName = CleanName(ofMembers(holder.Member));
      }
    }
  }
}
