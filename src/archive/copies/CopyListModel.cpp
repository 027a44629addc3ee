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

/// Why the folder cannot be read; empty if it can, or if there is none yet.
std::string WhyUnreadable(const Files& disk, const std::string& folder) {
  try {
    if (disk.FolderExists(folder)) {
      disk.FolderNames(folder);
    }
    return {};
  } catch (const RuntimeError& error) {
    return error.what();
  }
}

}  // namespace

std::string CopyListModel::Refresh(const std::string& folder) {
  beginResetModel();
  entries_.clear();
  for (std::size_t i = 0; i < databases_.size(); ++i) {
    AddInUse(i);
  }
  for (const BackupCopy& copy : CopiesIn(disk_, folder)) {
    for (std::size_t i = 0; i < databases_.size(); ++i) {
      if (databases_[i].Owns(copy)) {
        entries_.push_back({i, copy, SizeOf(disk_, work_.PathOf(copy))});
      }
    }
  }
  endResetModel();
  return WhyUnreadable(disk_, folder);
}

void CopyListModel::AddInUse(std::size_t database) {
  Entry entry{database, std::nullopt, 0};
  const std::string key = KeyOf(entry);
  counts_.erase(key);
  try {
    entry.Bytes = SizeOf(disk_, databases_[database].InUse().Path());
  } catch (const RuntimeError& error) {
    counts_[key] = {std::nullopt, error.what()};
  }
  entries_.push_back(entry);
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
  if (role == Qt::ToolTipRole || role == Qt::AccessibleDescriptionRole) {
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
      if (!entry.Copy && entry.Bytes == 0) {  // nobody knows
        return {};
      }
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
