#include "archive/copies/CopyListModel.h"

#include <QDateTime>
#include <QLocale>

#include "archive/copies/CopyTexts.h"
#include "platform/RuntimeError.h"
#include "platform/qt/QtClock.h"
#include "ui/Text.h"

namespace {

constexpr OwnText CopyHeads[] = {OwnText::CopyData, OwnText::CopyTime,       OwnText::CopyMade,
                                 OwnText::CopyRows, OwnText::CopyDifference, OwnText::CopySize};

std::uint64_t SizeOf(const Files& disk, const std::string& path) {
  try {
    return disk.FileLen(path);
  } catch (const RuntimeError&) {  // shown as unreadable when its rows are counted
    return 0;
  }
}

}  // namespace

void CopyListModel::Refresh(const std::string& folder) {
  beginResetModel();
  entries_.clear();
  for (std::size_t i = 0; i < databases_.size(); ++i) {
    entries_.push_back({i, std::nullopt, SizeOf(disk_, databases_[i].InUse().Path())});
    counts_.erase(KeyOf(entries_.back()));
  }
  for (const BackupCopy& copy : CopiesIn(disk_, folder)) {
    for (std::size_t i = 0; i < databases_.size(); ++i) {
      if (databases_[i].Owns(copy)) {
        entries_.push_back({i, copy, SizeOf(disk_, work_.PathOf(copy))});
      }
    }
  }
  endResetModel();
}

bool CopyListModel::CountNext() {
  for (int row = 0; row < rowCount(); ++row) {
    if (CountOf(At(row)) == nullptr) {
      counts_[KeyOf(At(row))] = CountRows(At(row));
      // The differences of all depend on the rows in use.
      const int last = At(row).Copy ? row : rowCount() - 1;
      emit dataChanged(index(row, 0), index(last, ColumnCount - 1));
      return true;
    }
  }
  return false;
}

int CopyListModel::rowCount(const QModelIndex& parent) const {
  return parent.isValid() ? 0 : static_cast<int>(entries_.size());
}

int CopyListModel::columnCount(const QModelIndex& parent) const {
  return parent.isValid() ? 0 : ColumnCount;
}

QVariant CopyListModel::data(const QModelIndex& index, int role) const {
  const Entry& entry = At(index.row());
  if (role == Qt::DisplayRole) {
    return TextOf(entry, index.column());
  }
  if (role == Qt::ToolTipRole) {
    const Count* count = CountOf(entry);
    if (count != nullptr && !count->Rows) {
      return QString::fromStdString(count->Reason);
    }
    return entry.Copy ? QString::fromStdString(entry.Copy->File) : QString();
  }
  if (role == Qt::TextAlignmentRole && (index.column() == Rows || index.column() == Size)) {
    return QVariant(Qt::AlignRight | Qt::AlignVCenter);
  }
  return {};
}

QVariant CopyListModel::headerData(int section, Qt::Orientation orientation, int role) const {
  if (orientation == Qt::Horizontal && role == Qt::DisplayRole) {
    return Text(strings_, CopyHeads[section]);
  }
  return QAbstractTableModel::headerData(section, orientation, role);
}

std::string CopyListModel::KeyOf(const Entry& entry) const {
  return entry.Copy ? entry.Copy->File + "/" + std::to_string(entry.Bytes)
                    : "/" + databases_[entry.Database].Name;
}

const CopyListModel::Count* CopyListModel::CountOf(const Entry& entry) const {
  const auto found = counts_.find(KeyOf(entry));
  return found == counts_.end() ? nullptr : &found->second;
}

CopyListModel::Count CopyListModel::CountRows(const Entry& entry) const {
  const CopiedDatabase& database = databases_[entry.Database];
  try {
    return {entry.Copy ? work_.RowsIn(*entry.Copy, database)
                       : database.InUse().OpenRecordset(database.Table)->RecordCount(),
            {}};
  } catch (const RuntimeError& error) {
    return {std::nullopt, error.what()};
  }
}

QString CopyListModel::TextOf(const Entry& entry, int column) const {
  switch (column) {
    case Data:
      return Text(strings_, databases_[entry.Database].Title);
    case Time:
      return TimeText(entry);
    case Made:
      return entry.Copy ? QString::fromStdString(::TextOf(entry.Copy->Kind, strings_))
                        : Text(strings_, OwnText::CopyInUse);
    case Rows:
      return RowsText(entry);
    case Difference:
      return DifferenceTo(entry);
    default:
      return QLocale::system().formattedDataSize(static_cast<qint64>(entry.Bytes));
  }
}

QString CopyListModel::TimeText(const Entry& entry) const {
  if (!entry.Copy) {
    return Text(strings_, OwnText::CopyIsNow);
  }
  const QString stored = QString::fromStdString(entry.Copy->Time);
  const QDateTime time = QDateTime::fromString(stored, QStringLiteral("yyyy-MM-dd HH:mm:ss"));
  const QLocale locale = QLocale::system();
  return time.isValid() ? QString::fromStdString(ShortDateText(locale, time.date()) + " " +
                                                 ShortTimeText(locale, time.time()))
                        : stored;
}

QString CopyListModel::RowsText(const Entry& entry) const {
  const Count* count = CountOf(entry);
  if (count == nullptr) {
    return QStringLiteral("...");
  }
  return count->Rows ? QString::number(*count->Rows) : Text(strings_, OwnText::CopyUnreadable);
}

QString CopyListModel::DifferenceTo(const Entry& entry) const {
  const Count* count = CountOf(entry);
  const Count* now = CountOf({entry.Database, std::nullopt, 0});
  const bool known = entry.Copy && count != nullptr && count->Rows && now != nullptr && now->Rows;
  return known ? QString::fromStdString(DifferenceText(*count->Rows, *now->Rows, strings_)) : QString();
}
