#include "devices/baseunit/DownloadedGuns.h"

void DownloadedGuns::AnalyseData(ReceiveBuffer& buffer, const Clock& clock) {
  const int index = IndexFromId(buffer[4]);
  if (!OneBased<Player, PlayerCount>::Holds(index)) {
    ::AnalyseData(buffer, game_, clock);
    return;
  }
  Player& player = game_.Players(index);
  bool isFirst = !player.Active;
  if (current_.insert(index).second) {
    if (const auto earlier = unsettled_.extract(index)) {
      TakeBack(earlier.mapped(), player);
      isFirst = earlier.mapped().First;
    }
  }
  if (isFirst) {
    countedTwice_.erase(index);
  } else {
    countedTwice_.insert(index);
  }
  Player before = player;
  ::AnalyseData(buffer, game_, clock);
  Amounts& amounts =
      unsettled_.try_emplace(index, Amounts{.Counters = {}, .Hits = {}, .First = isFirst}).first->second;
  AddDifference(amounts, before, player);
}

void DownloadedGuns::ComesOtherwise(int index) {
  if (!OneBased<Player, PlayerCount>::Holds(index)) {
    return;
  }
  if (game_.Players(index).Active) {
    countedTwice_.insert(index);
  }
  if (const auto earlier = unsettled_.find(index); earlier != unsettled_.end()) {
    earlier->second.First = false;  // without what it gave before, the game holds this
  }
}

void DownloadedGuns::Settle() {
  unsettled_.clear();
  current_.clear();
}

void DownloadedGuns::Forget() {
  Settle();
  countedTwice_.clear();
}

std::array<std::int32_t*, DownloadedGuns::CounterCount> DownloadedGuns::CountersOf(Player& player) {
  return {&player.ShotCount,       &player.HealCount,       &player.AmmoAddCount,
          &player.AdminKillCount,  &player.DeathCount,      &player.RespawnCount,
          &player.ExplosiveDamage, &player.RadiationDamage, &player.StunCount};
}

void DownloadedGuns::AddDifference(Amounts& amounts, Player& before, Player& after) {
  const auto old = CountersOf(before);
  const auto now = CountersOf(after);
  for (std::size_t i = 0; i < CounterCount; ++i) {
    amounts.Counters[i] += *now[i] - *old[i];
  }
  for (int shooter = 1; shooter <= PlayerCount; ++shooter) {
    if (const std::int32_t added = after.HitByPlayer(shooter) - before.HitByPlayer(shooter); added != 0) {
      amounts.Hits[shooter] += added;
    }
  }
}

void DownloadedGuns::TakeBack(const Amounts& amounts, Player& player) {
  const auto counters = CountersOf(player);
  for (std::size_t i = 0; i < CounterCount; ++i) {
    *counters[i] -= amounts.Counters[i];
  }
  for (const auto& [shooter, added] : amounts.Hits) {
    player.HitByPlayer(shooter) -= added;
  }
}
