#include "sound/SoundListModel.h"

#include <array>

#include "core/text/NumberForms.h"
#include "sound/SoundPages.h"

namespace {

/// No path is longer, but a play list may hold anything.
constexpr qsizetype LongestToolTip = 4096;

QString TextOf(const SoundRow& row, int column) {
  switch (column) {
    case SoundListModel::EventColumn:
      return QString::fromStdString(row.Event);
    case SoundListModel::FileColumn:
      return QString::fromStdString(row.File);
    case SoundListModel::SecondsColumn:
      return row.Pages ? QString::fromStdString(FormatFixed(SoundChip::SecondsOf(*row.Pages), 2)) : QString();
    default:
      return row.Pages ? QString::number(*row.Pages) : QString();
  }
}

}  // namespace

SoundListModel::SoundListModel(const SoundList& list, const QString& seconds, const QString& pages,
                               QObject* parent)
    : QAbstractTableModel(parent), list_(list), seconds_(seconds), pages_(pages) {}

void SoundListModel::Reset() {
  beginResetModel();
  shownRows_ = static_cast<int>(list_.Rows().size());
  endResetModel();
}

void SoundListModel::Refresh() {
  if (shownRows_ > 0) {
    emit dataChanged(index(0, FileColumn), index(shownRows_ - 1, ColumnCount - 1));
  }
}

int SoundListModel::rowCount(const QModelIndex& parent) const {
  return parent.isValid() ? 0 : shownRows_;
}

int SoundListModel::columnCount(const QModelIndex& parent) const {
  return parent.isValid() ? 0 : ColumnCount;
}

QVariant SoundListModel::data(const QModelIndex& index, int role) const {
  if (!index.isValid() || index.row() >= static_cast<int>(list_.Rows().size())) {
    return {};
  }
  const SoundRow& row = list_.Rows()[static_cast<std::size_t>(index.row())];
  switch (role) {
    case Qt::DisplayRole:
      return TextOf(row, index.column());
    case Qt::ToolTipRole:
      return index.column() <= FileColumn ? TextOf(row, index.column()).left(LongestToolTip) : QVariant();
    case Qt::TextAlignmentRole:
      return QVariant(Qt::AlignVCenter | (index.column() >= SecondsColumn ? Qt::AlignRight : Qt::AlignLeft));
    default:
      return {};
  }
}

QVariant SoundListModel::headerData(int section, Qt::Orientation orientation, int role) const {
  if (orientation != Qt::Horizontal || section < 0 || section >= ColumnCount) {
    return {};
  }
  if (role == Qt::TextAlignmentRole) {
    return QVariant(Qt::AlignVCenter | (section >= SecondsColumn ? Qt::AlignRight : Qt::AlignLeft));
  }
  if (role != Qt::DisplayRole) {
    return {};
  }
  const std::array captions = {QStringLiteral("Sound Event"), QStringLiteral("File"), seconds_, pages_};
  return captions.at(static_cast<std::size_t>(section));
}
