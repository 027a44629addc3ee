#include "devices/radio/GunListModel.h"

#include <QGuiApplication>
#include <QPalette>
#include <QStringList>
#include <array>
#include <cstddef>

#include "core/game/PlayerId.h"
#include "devices/radio/GunPictures.h"
#include "ui/TeamColours.h"

namespace {

constexpr int PlayerColumn = 0;
constexpr int BatteryColumn = 2;
constexpr int StatusColumn = 4;
constexpr int ColumnCount = 5;

}  // namespace

GunListModel::Row::Row(const GunEntry& gun)
    : Gun(gun), Battery(BatteryPicture(gun.Battery)), Status(StatusPicture(gun.ScoreStatus)) {}

GunListModel::GunListModel(const QString& player, QObject* parent)
    : QAbstractTableModel(parent), player_(player) {}

void GunListModel::Show(const GunTable& guns, std::int16_t maxPlayerId) {
  std::size_t row = 0;
  for (const int index : ListedGuns(guns, maxPlayerId)) {
    const GunEntry& gun = guns[static_cast<std::size_t>(index)];
    const int shownRow = static_cast<int>(row);
    if (row == rows_.size() || gun.PlayerID < rows_[row].Gun.PlayerID) {
      beginInsertRows({}, shownRow, shownRow);
      rows_.insert(rows_.begin() + shownRow, Row(gun));
      endInsertRows();
    } else if (gun != rows_[row].Gun) {
      rows_[row] = Row(gun);
      emit dataChanged(this->index(shownRow, 0), this->index(shownRow, ColumnCount - 1));
    }
    ++row;
  }
}

void GunListModel::Clear() {
  beginResetModel();
  rows_.clear();
  endResetModel();
}

int GunListModel::rowCount(const QModelIndex& parent) const {
  return parent.isValid() ? 0 : static_cast<int>(rows_.size());
}

int GunListModel::columnCount(const QModelIndex& parent) const {
  return parent.isValid() ? 0 : ColumnCount;
}

QVariant GunListModel::data(const QModelIndex& index, int role) const {
  if (!index.isValid() || index.row() >= rowCount()) {
    return {};
  }
  const Row& row = rows_[static_cast<std::size_t>(index.row())];
  switch (role) {
    case Qt::DisplayRole:
      return QString::fromStdString(RowOf(row.Gun)[static_cast<std::size_t>(index.column())]);
    case Qt::DecorationRole:
      return SignOf(row, index.column());
    case Qt::BackgroundRole:
      return StatusTint(row.Gun.ScoreStatus, QGuiApplication::palette().base().color());
    default:
      return {};
  }
}

QVariant GunListModel::SignOf(const Row& row, int column) {
  switch (column) {
    case PlayerColumn:
      return TeamBadge(TeamFromId(static_cast<std::uint8_t>(row.Gun.PlayerID)));
    case BatteryColumn:
      return row.Battery;
    case StatusColumn:
      return row.Status;
    default:
      return {};
  }
}

QVariant GunListModel::headerData(int section, Qt::Orientation orientation, int role) const {
  if (orientation != Qt::Horizontal || section < 0 || section >= ColumnCount) {
    return {};
  }
  if (role == Qt::TextAlignmentRole) {
    return QVariant(Qt::AlignVCenter | Qt::AlignLeft);
  }
  if (role != Qt::DisplayRole) {
    return {};
  }
  const std::array captions = {player_, QStringLiteral("Firmware Version"), QStringLiteral("Battery Level"),
                               QStringLiteral("Weapon Type"), QStringLiteral("Status")};
  return captions[static_cast<std::size_t>(section)];
}
