#include "charts/ChartTables.h"

#include <algorithm>
#include <tuple>

#include "charts/PartLook.h"
#include "ui/Text.h"

namespace {

constexpr int DamageColumn = 2;
constexpr int OwnTeamColumn = 3;
constexpr int FirstPartColumn = 2;

auto OrderOf(const HitCell& cell) {
  return std::tuple(cell.Shooter, cell.Victim);
}

}  // namespace

void HitRows::Show(const HitMatrix& matrix) {
  beginResetModel();
  matrix_ = &matrix;
  cells_.clear();
  for (int shooter = 0; shooter < matrix.Size(); ++shooter) {
    for (int victim = 0; victim < matrix.Size(); ++victim) {
      if (matrix.Damage(shooter, victim) > 0) {
        cells_.push_back({shooter, victim});
      }
    }
  }
  endResetModel();
}

std::optional<int> HitRows::RowOf(const HitCell& cell) const {
  const auto found = std::lower_bound(
      cells_.begin(), cells_.end(), cell,
      [](const HitCell& left, const HitCell& right) { return OrderOf(left) < OrderOf(right); });
  return found != cells_.end() && *found == cell ? std::optional(static_cast<int>(found - cells_.begin()))
                                                 : std::nullopt;
}

int HitRows::Rows() const {
  return static_cast<int>(cells_.size());
}

int HitRows::Columns() const {
  return matrix_ == nullptr || matrix_->HasTeams() ? OwnTeamColumn + 1 : OwnTeamColumn;
}

bool HitRows::IsText(int column) const {
  return column != DamageColumn;
}

QString HitRows::Caption(int column) const {
  constexpr int damage = 107;
  const int texts[] = {static_cast<int>(OwnText::WhoHit), static_cast<int>(OwnText::WhoWasHit), damage,
                       static_cast<int>(OwnText::OwnTeam)};
  return Text(strings_, texts[column]);
}

QString HitRows::Cell(int row, int column) const {
  const HitCell cell = CellOf(row);
  switch (column) {
    case 0:
      return QString::fromStdString(matrix_->PlayerAt(cell.Shooter).Name);
    case 1:
      return QString::fromStdString(matrix_->PlayerAt(cell.Victim).Name);
    case DamageColumn:
      return QString::number(matrix_->Damage(cell.Shooter, cell.Victim));
    default:
      return matrix_->IsOwnTeam(cell.Shooter, cell.Victim) ? Text(strings_, OwnText::OwnTeamYes) : QString();
  }
}

void ScoreRows::Show(const std::vector<PlayerParts>& players) {
  beginResetModel();
  players_ = &players;
  parts_ = PartsInUse(players);
  endResetModel();
}

int ScoreRows::Rows() const {
  return players_ == nullptr ? 0 : static_cast<int>(players_->size());
}

int ScoreRows::Columns() const {
  return FirstPartColumn + static_cast<int>(parts_.size());
}

bool ScoreRows::IsText(int column) const {
  return column == 0;
}

QString ScoreRows::Caption(int column) const {
  constexpr int player = 104;
  constexpr int soldiering = 105;
  return column < FirstPartColumn
             ? Text(strings_, column == 0 ? player : soldiering)
             : NameOfPart(parts_.at(static_cast<std::size_t>(column - FirstPartColumn)), strings_);
}

QString ScoreRows::Cell(int row, int column) const {
  const PlayerParts& player = players_->at(static_cast<std::size_t>(row));
  if (column == 0) {
    return QString::fromStdString(player.Player.Name);
  }
  if (column < FirstPartColumn) {
    return QString::number(player.Soldiering);
  }
  const ScorePart part = parts_.at(static_cast<std::size_t>(column - FirstPartColumn));
  return QString::fromStdString(PointsText(player.Of(part)));
}
