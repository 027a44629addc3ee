#include "takeover/FoundModel.h"

#include <QDateTime>
#include <QLocale>

#include "core/text/Filled.h"
#include "platform/qt/QtClock.h"
#include "ui/Text.h"

namespace {

constexpr OwnText FoundHeads[] = {OwnText::CopyData, OwnText::TakeOverFound, OwnText::TakeOverInUse,
                                  OwnText::TakeOverRemarks};

/// The day of "YYYY-MM-DD HH:MM:SS" in the system's form; another text as it stands.
std::string DayOf(const std::string& time) {
  const QDateTime parsed =
      QDateTime::fromString(QString::fromStdString(time), QStringLiteral("yyyy-MM-dd HH:mm:ss"));
  return parsed.isValid() ? ShortDateText(QLocale::system(), parsed.date()) : time;
}

}  // namespace

const std::string& TitleOf(OldItem item, const StringTable& strings) {
  switch (item) {
    case OldItem::Members:
      return strings.Text(OwnText::CopiedMembers);
    case OldItem::Missions:
      return strings.Text(OwnText::CopiedMissions);
    case OldItem::Template:
      return strings.Text(OwnText::TakeOverTemplate);
    case OldItem::Settings:
      return strings.Text(OwnText::TakeOverSettings);
    case OldItem::Games:
      break;
  }
  return strings.Text(OwnText::TakeOverGames);
}

void FoundModel::Show(std::vector<FoundItem> items) {
  beginResetModel();
  items_ = std::move(items);
  ticked_.clear();
  for (const FoundItem& item : items_) {
    if (item.State == FoundItem::Usable) {
      ticked_.insert(item.What);
    }
  }
  endResetModel();
}

int FoundModel::rowCount(const QModelIndex& parent) const {
  return parent.isValid() ? 0 : static_cast<int>(items_.size());
}

int FoundModel::columnCount(const QModelIndex& parent) const {
  return parent.isValid() ? 0 : ColumnCount;
}

QVariant FoundModel::data(const QModelIndex& index, int role) const {
  const FoundItem& item = At(index);
  if (role == Qt::DisplayRole) {
    return TextOf(item, index.column());
  }
  if (role == Qt::ToolTipRole) {
    return QString::fromStdString(item.Remark);
  }
  if (role == Qt::CheckStateRole && index.column() == Data && item.State == FoundItem::Usable) {
    return ticked_.contains(item.What) ? Qt::Checked : Qt::Unchecked;
  }
  return {};
}

bool FoundModel::setData(const QModelIndex& index, const QVariant& value, int role) {
  const FoundItem& item = At(index);
  if (role != Qt::CheckStateRole || index.column() != Data || item.State != FoundItem::Usable) {
    return false;
  }
  if (value.toInt() == Qt::Checked) {
    ticked_.insert(item.What);
  } else {
    ticked_.erase(item.What);
  }
  emit dataChanged(index, index, {Qt::CheckStateRole});
  return true;
}

Qt::ItemFlags FoundModel::flags(const QModelIndex& index) const {
  const Qt::ItemFlags usual = QAbstractTableModel::flags(index);
  const bool hasTick = index.column() == Data && At(index).State == FoundItem::Usable;
  return hasTick ? usual | Qt::ItemIsUserCheckable : usual;
}

QVariant FoundModel::headerData(int section, Qt::Orientation orientation, int role) const {
  if (orientation == Qt::Horizontal && role == Qt::DisplayRole) {
    return Text(strings_, FoundHeads[section]);
  }
  return QAbstractTableModel::headerData(section, orientation, role);
}

QString FoundModel::TextOf(const FoundItem& item, int column) const {
  switch (column) {
    case Data:
      return QString::fromStdString(TitleOf(item.What, strings_));
    case Found:
      return QString::fromStdString(FoundText(item));
    case InUse:
      return QString::fromStdString(InUseText(item));
    default:
      return QString::fromStdString(item.Remark).section(u'\n', 0, 0);
  }
}

std::string FoundModel::FoundText(const FoundItem& item) const {
  if (item.State == FoundItem::Missing) {
    return strings_.Text(OwnText::TakeOverMissing);
  }
  if (item.State == FoundItem::Unusable) {
    return strings_.Text(OwnText::CopyUnreadable);
  }
  const std::string count = std::to_string(item.Count);
  switch (item.What) {
    case OldItem::Members:
    case OldItem::Missions:
      return Filled(strings_.Text(OwnText::TakeOverRows), {count, DayOf(item.Changed)});
    case OldItem::Template:
      return Filled(strings_.Text(OwnText::TakeOverChanged), {DayOf(item.Changed)});
    case OldItem::Settings:
      return Filled(strings_.Text(OwnText::TakeOverSettingsFound), {count, std::to_string(item.Different)});
    case OldItem::Games:
      break;
  }
  return Filled(strings_.Text(OwnText::TakeOverGameFiles), {count, DayOf(item.Changed), DayOf(item.Latest)});
}

std::string FoundModel::InUseText(const FoundItem& item) const {
  switch (item.What) {
    case OldItem::Members:
    case OldItem::Missions:
      return Filled(strings_.Text(OwnText::TakeOverRows),
                    {std::to_string(item.CountNow), DayOf(item.ChangedNow)});
    case OldItem::Template:
    case OldItem::Settings:
      return Filled(strings_.Text(OwnText::TakeOverChanged), {DayOf(item.ChangedNow)});
    case OldItem::Games:
      break;
  }
  return {};
}
