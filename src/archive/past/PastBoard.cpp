#include "archive/past/PastBoard.h"

namespace {

AccuracyKind AccuracyKindOf(const Player& player) {
  if (player.PrimaryDamage == 0) {
    return AccuracyKind::NoPrimaryDamage;
  }
  return player.ShotCount > 0 ? AccuracyKind::Known : AccuracyKind::NoShots;
}

BoardRow PastRowOf(const Player& player, int index, const MemberNames& nameOf) {
  return {.Index = index,
          .Team = TeamFromId(IdFromIndex(index)),
          .MemberName = player.MemberIndex != 0 ? nameOf(player.MemberIndex) : std::string(),
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

void ListPastPlayers(Game& game, const MemberNames& nameOf, Board& board) {
  board.Clear();
  for (int index = 1; index <= PlayerCount; ++index) {
    if (const Player& player = game.Players(index); player.Active) {
      board.AddRow(PastRowOf(player, index, nameOf));
    }
  }
  SortListNumeric(board, BoardColumn::Soldiering, true, game);
}
