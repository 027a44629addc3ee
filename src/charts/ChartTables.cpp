#include "charts/ChartTables.h"

#include <algorithm>
#include <tuple>

#include "charts/PartLook.h"
#include "ui/Text.h"

namespace {

constexpr int OwnTeamColumn = 3;
constexpr int FirstPartColumn = 2;

QVariant SideOf(bool isText) {
  return QVariant(Qt::AlignVCenter | (isText ? Qt::AlignLeft : Qt::AlignRight));
}

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

int HitRows::rowCount(const QModelIndex& parent) const {
  return parent.isValid() ? 0 : static_cast<int>(cells_.size());
}

int HitRows::columnCount(const QModelIndex& parent) const {
  if (parent.isValid()) {
    return 0;
  }
  return matrix_ == nullptr || matrix_->HasTeams() ? OwnTeamColumn + 1 : OwnTeamColumn;
}

QVariant HitRows::data(const QModelIndex& index, int role) const {
  constexpr int damageColumn = 2;
  if (role == Qt::TextAlignmentRole) {
    return SideOf(index.column() != damageColumn);
  }
  if (role != Qt::DisplayRole) {
    return {};
  }
  const HitCell cell = CellOf(index.row());
  switch (index.column()) {
    case 0:
      return QString::fromStdString(matrix_->PlayerAt(cell.Shooter).Name);
    case 1:
      return QString::fromStdString(matrix_->PlayerAt(cell.Victim).Name);
    case damageColumn:
      return QString::number(matrix_->Damage(cell.Shooter, cell.Victim));
    default:
      return matrix_->IsOwnTeam(cell.Shooter, cell.Victim) ? Text(strings_, OwnText::OwnTeamYes) : QString();
  }
}

QVariant HitRows::headerData(int section, Qt::Orientation orientation, int role) const {
  if (orientation != Qt::Horizontal || (role != Qt::DisplayRole && role != Qt::TextAlignmentRole)) {
    return {};
  }
  if (role == Qt::TextAlignmentRole) {
    return SideOf(section != 2);
  }
  const int texts[] = {static_cast<int>(OwnText::WhoHit), static_cast<int>(OwnText::WhoWasHit), 107,
                       static_cast<int>(OwnText::OwnTeam)};
  return Text(strings_, texts[section]);
}

void ScoreRows::Show(const std::vector<PlayerParts>& players) {
  beginResetModel();
  players_ = &players;
  parts_ = PartsInUse(players);
  endResetModel();
}

int ScoreRows::rowCount(const QModelIndex& parent) const {
  return parent.isValid() || players_ == nullptr ? 0 : static_cast<int>(players_->size());
}

int ScoreRows::columnCount(const QModelIndex& parent) const {
  return parent.isValid() ? 0 : FirstPartColumn + static_cast<int>(parts_.size());
}

QVariant ScoreRows::data(const QModelIndex& index, int role) const {
  if (role == Qt::TextAlignmentRole) {
    return SideOf(index.column() == 0);
  }
  if (role != Qt::DisplayRole) {
    return {};
  }
  const PlayerParts& player = players_->at(static_cast<std::size_t>(index.row()));
  if (index.column() == 0) {
    return QString::fromStdString(player.Player.Name);
  }
  if (index.column() < FirstPartColumn) {
    return QString::number(player.Soldiering);
  }
  const ScorePart part = parts_.at(static_cast<std::size_t>(index.column() - FirstPartColumn));
  return QString::fromStdString(PointsText(player.Of(part)));
}

QVariant ScoreRows::headerData(int section, Qt::Orientation orientation, int role) const {
  if (orientation != Qt::Horizontal) {
    return {};
  }
  if (role == Qt::TextAlignmentRole) {
    return SideOf(section == 0);
  }
  if (role != Qt::DisplayRole) {
    return {};
  }
  if (section < FirstPartColumn) {
    constexpr int player = 104;
    constexpr int soldiering = 105;
    return Text(strings_, section == 0 ? player : soldiering);
  }
  return NameOfPart(parts_.at(static_cast<std::size_t>(section - FirstPartColumn)), strings_);
}
