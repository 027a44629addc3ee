#include "archive/past/PastBoard.h"

#include "core/game/HiddenNames.h"

namespace {

AccuracyKind AccuracyKindOf(const Player& player) {
  if (player.PrimaryDamage == 0) {
    return AccuracyKind::NoPrimaryDamage;
  }
  return player.ShotCount > 0 ? AccuracyKind::Known : AccuracyKind::NoShots;
}

BoardRow PastRowOf(const Player& player, int index, const NameHolder& holder) {
  return {.Index = index,
          .Team = TeamFromId(IdFromIndex(index)),
          .MemberName = holder.NickName.empty() ? holder.GuestName : holder.NickName,
          .Soldiering = player.Soldiering,
          .HasAccuracy = AccuracyKindOf(player),
          .Accuracy = player.Accuracy,
          .Damage = player.TotalDamage,
          .ShotsFired = player.ShotCount,
          .Wia = player.HealCount,
          .Kia = player.DeathCount,
          .AmmoAdds = player.AmmoAddCount};
}

}  // namespace

void ListPastPlayers(PastGame& past, const NickNames& nickNames, Board& board) {
  board.Clear();
  Game& game = past.Game;
  const GuestNames guests = past.NamesOfGuests();
  for (int index = 1; index <= PlayerCount; ++index) {
    if (const Player& player = game.Players(index); player.Active) {
      board.AddRow(PastRowOf(player, index, HolderOf(game, index, nickNames, guests)));
    }
  }
  SortListNumeric(board, BoardColumn::Soldiering, true, game);
}
