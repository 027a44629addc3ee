#include "core/game/BoardTexts.h"

#include "core/text/Filled.h"
#include "core/text/NumberForms.h"

std::string BoardTexts::Header(BoardList list, BoardColumn column) const {
  constexpr int firstOfPlayers = 103;
  constexpr int ofTeams[TeamColumnCount] = {112, 113, 105};
  const int at = static_cast<int>(column);
  return strings_.Text(list == BoardList::Players ? firstOfPlayers + at : ofTeams[at]);
}

std::string BoardTexts::HeaderTip(BoardList list, BoardColumn column) const {
  const OwnText first = list == BoardList::Players ? OwnText::RankTip : OwnText::TeamRankTip;
  return Filled(strings_.Text(static_cast<int>(first) + static_cast<int>(column)), {Header(list, column)});
}

std::string BoardTexts::Cell(const BoardRow& row, BoardColumn column) const {
  switch (column) {
    case BoardColumn::Rank:
      return std::to_string(row.Rank);
    case BoardColumn::Player:
      return row.MemberName.empty() ? Name(row) : Name(row) + ": " + row.MemberName;
    case BoardColumn::Soldiering:
      return Str(row.Soldiering);
    case BoardColumn::Accuracy:
      return AccuracyText(row);
    case BoardColumn::Damage:
      return Str(row.Damage);
    case BoardColumn::ShotsFired:
      return Str(row.ShotsFired);
    case BoardColumn::Wia:
      return Str(row.Wia);
    case BoardColumn::Kia:
      return Str(row.Kia);
    case BoardColumn::AmmoAdds:
      return Str(row.AmmoAdds);
  }
  return {};
}

std::string BoardTexts::Name(const BoardRow& row) const {
  return row.Index == 0 ? game_.TeamNames(row.Team) : game_.DisplayName(row.Index);
}

std::string BoardTexts::AccuracyText(const BoardRow& row) const {
  switch (row.HasAccuracy) {
    case AccuracyKind::Known:
      return FormatPercent(row.Accuracy);
    case AccuracyKind::NoShots:
      return "N/A";  // in every language
    case AccuracyKind::NoPrimaryDamage:
      return strings_.Text(126);
  }
  return {};
}

std::string PlayerText(int index, const Board& players, const Game& game, const BoardTexts& texts) {
  const std::optional<int> place = players.PlaceOf(index);
  return place ? texts.Cell(players.RowAt(*place), BoardColumn::Player) : game.DisplayName(index);
}
