#include "archive/past/PastGameModel.h"

#include <QDateTime>
#include <QLocale>
#include <algorithm>
#include <utility>

#include "core/game/PlayerId.h"
#include "platform/RuntimeError.h"
#include "platform/qt/QtClock.h"
#include "ui/Text.h"

namespace {

/// More rows than any screen shows; then all are read anew.
constexpr std::size_t MostRowsKept = 2000;

bool IsTeamColumn(int column) {
  return column >= PastGameModel::FirstTeam && column <= PastGameModel::LastTeam;
}

bool IsNumberColumn(int column) {
  return IsTeamColumn(column) || column == PastGameModel::Players || column == PastGameModel::Pulls ||
         column == PastGameModel::Committed;
}

}  // namespace

PastGameModel::PastGameModel(Parts parts, const StringTable& strings)
    : parts_(std::move(parts)), strings_(strings) {}

void PastGameModel::Show(std::vector<std::int64_t> games) {
  beginResetModel();
  games_ = std::move(games);
  rows_.clear();
  failed_ = false;
  endResetModel();
}

int PastGameModel::RowOf(std::int64_t gameId) const {
  const auto found = std::find(games_.begin(), games_.end(), gameId);
  return found == games_.end() ? -1 : static_cast<int>(found - games_.begin());
}

const ListedGame* PastGameModel::GameIn(int row) const {
  const Row* found = RowAt(row);
  return found != nullptr ? &found->Game : nullptr;
}

QString PastGameModel::TimeText(const std::string& played) {
  const QString stored = QString::fromStdString(played);
  const QDateTime time = QDateTime::fromString(stored, QStringLiteral("yyyy-MM-dd HH:mm:ss"));
  const QLocale locale = QLocale::system();
  return time.isValid() ? QString::fromStdString(ShortDateText(locale, time.date()) + " " +
                                                 ShortTimeText(locale, time.time()))
                        : stored;
}

int PastGameModel::rowCount(const QModelIndex& parent) const {
  return parent.isValid() ? 0 : static_cast<int>(games_.size());
}

int PastGameModel::columnCount(const QModelIndex& parent) const {
  return parent.isValid() ? 0 : ColumnCount;
}

QVariant PastGameModel::data(const QModelIndex& index, int role) const {
  if (role == Qt::TextAlignmentRole) {
    return QVariant((IsNumberColumn(index.column()) ? Qt::AlignRight : Qt::AlignLeft) | Qt::AlignVCenter);
  }
  if (role != Qt::DisplayRole) {
    return {};
  }
  const Row* row = RowAt(index.row());
  return row != nullptr ? TextOf(*row, index.column()) : QString();
}

QVariant PastGameModel::headerData(int section, Qt::Orientation orientation, int role) const {
  if (orientation != Qt::Horizontal) {
    return QAbstractTableModel::headerData(section, orientation, role);
  }
  if (role == Qt::TextAlignmentRole) {
    return QVariant((IsNumberColumn(section) ? Qt::AlignRight : Qt::AlignLeft) | Qt::AlignVCenter);
  }
  if (role != Qt::DisplayRole) {
    return {};
  }
  if (IsTeamColumn(section)) {
    return QString::fromStdString(
        TeamNameFromNumber(strings_, static_cast<std::int16_t>(section - FirstTeam + 1)));
  }
  return TextList(strings_, OwnText::PastGameHeads)
      .value(section < FirstTeam ? section : section - static_cast<int>(TeamCount));
}

const PastGameModel::Row* PastGameModel::RowAt(int row) const {
  const std::int64_t game = games_[static_cast<std::size_t>(row)];
  auto found = rows_.find(game);
  if (found == rows_.end()) {
    if (rows_.size() >= MostRowsKept) {
      rows_.clear();
    }
    found = rows_.emplace(game, ReadRow(game)).first;
  }
  return found->second ? &*found->second : nullptr;
}

std::optional<PastGameModel::Row> PastGameModel::ReadRow(std::int64_t gameId) const {
  if (failed_) {
    return std::nullopt;  // a locked file makes each attempt wait
  }
  try {
    std::optional<ListedGame> game = parts_.Read(gameId);
    if (!game) {
      return std::nullopt;
    }
    std::string best = BestOf(*game);
    return Row{std::move(*game), std::move(best)};
  } catch (const RuntimeError& error) {
    failed_ = true;
    parts_.Failed(error.what());
    return std::nullopt;
  }
}

std::string PastGameModel::BestOf(const ListedGame& game) const {
  if (game.BestPlayer < 1 || game.BestPlayer > PlayerCount) {
    return {};
  }
  std::string name = game.BestMember != 0 ? CleanName(parts_.NickNameOf(game.BestMember)) : std::string();
  if (name.empty()) {
    name = parts_.GuestNameOf(game.GameId, game.BestPlayer);
  }
  if (!name.empty()) {
    return name;
  }
  const std::uint8_t id = IdFromIndex(game.BestPlayer);
  return TeamNameFromNumber(strings_, TeamFromId(id)) + " " + std::to_string(PlayerNumberFromId(id));
}

QString PastGameModel::TextOf(const Row& row, int column) const {
  const ListedGame& game = row.Game;
  if (IsTeamColumn(column)) {
    return QString::number(game.TeamTotals.at(static_cast<std::size_t>(column - FirstTeam)));
  }
  switch (column) {
    case Time:
      return TimeText(game.Played);
    case Mission:
      return QString::fromStdString(game.Mission);
    case Players:
      return QString::number(game.Players);
    case Best:
      return game.BestPlayer == 0
                 ? QString()
                 : QString::fromStdString(row.Best + ", ") + QString::number(game.BestSoldiering);
    case Pulls:
      return QString::number(game.Pulls);
    default:
      return QString::number(game.Committed);
  }
}
