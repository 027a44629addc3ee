#include "members/MemberListModel.h"

#include <QDateTime>
#include <QLocale>
#include <QStringList>
#include <algorithm>

#include "core/text/Filled.h"
#include "members/PictureReader.h"
#include "platform/qt/QtClock.h"
#include "ui/Text.h"

namespace {

/// Several times what a window shows. When more were read, all are forgotten.
constexpr std::size_t MostRows = 500;
constexpr std::size_t MostPhotos = 500;
/// Details of rows that have been scrolled past are given up.
constexpr std::size_t MostWanted = 60;

/// For a picture 40 units high on a screen with two pixels to the unit.
constexpr QSize PhotoSize(80, 80);

}  // namespace

MemberListModel::MemberListModel(Database& dbMembers, const StringTable& strings, QObject* parent)
    : QAbstractListModel(parent), strings_(strings), hits_(dbMembers) {}

void MemberListModel::Search(const std::string& text) {
  beginResetModel();
  rows_.clear();
  wanted_.clear();
  hits_.Search(text);
  count_ = hits_.Count();
  endResetModel();
}

std::int64_t MemberListModel::MemberIn(int row) {
  return row < 0 || row >= count_ ? 0 : RowAt(row).Hit.ContactId;
}

bool MemberListModel::ReadNextDetails() {
  if (wanted_.empty()) {
    return false;
  }
  const int number = wanted_.front();
  wanted_.pop_front();
  Row& row = RowAt(number);
  SharesName(row);
  if (row.Hit.HasPhoto && !photos_.contains(row.Hit.ContactId)) {
    if (photos_.size() >= MostPhotos) {
      photos_.clear();
    }
    photos_[row.Hit.ContactId] = QPixmap::fromImage(ReadPicture(hits_.Photo(number), PhotoSize));
  }
  return !wanted_.empty();
}

int MemberListModel::rowCount(const QModelIndex& parent) const {
  return parent.isValid() ? 0 : count_;
}

QVariant MemberListModel::data(const QModelIndex& index, int role) const {
  if (!index.isValid() || index.row() >= count_) {
    return {};
  }
  Row& row = RowAt(index.row());
  switch (role) {
    case Qt::DisplayRole:
      return QString::fromStdString(row.Hit.Name());
    case Qt::DecorationRole:
      return PhotoOf(index.row(), row.Hit);
    case Qt::ToolTipRole:
      return SharesName(row) ? Text(strings_, OwnText::SharedName) : QString();
    case Qt::AccessibleTextRole:
      return SpokenText(row);
    case NickNameRole:
      return QString::fromStdString(row.Hit.NickName);
    case LastPlayedRole:
      return LastPlayedText(row.Hit);
    case LastPlayedDateRole:
      return LastPlayedDate(row.Hit);
    case SharedNameRole:
      if (!row.SharesName) {
        WantDetails(index.row());
      }
      return row.SharesName.value_or(false);
    default:
      return {};
  }
}

MemberListModel::Row& MemberListModel::RowAt(int row) const {
  if (const auto held = rows_.find(row); held != rows_.end()) {
    return held->second;
  }
  if (rows_.size() >= MostRows) {
    rows_.clear();
  }
  Row read;
  if (const std::optional<MemberHit> hit = hits_.At(row)) {
    read.Hit = *hit;
  }
  return rows_.emplace(row, std::move(read)).first->second;
}

bool MemberListModel::SharesName(Row& row) const {
  if (!row.SharesName) {
    row.SharesName = hits_.SharesName(row.Hit);
  }
  return *row.SharesName;
}

void MemberListModel::WantDetails(int row) const {
  if (std::find(wanted_.begin(), wanted_.end(), row) != wanted_.end()) {
    return;
  }
  wanted_.push_back(row);
  if (wanted_.size() > MostWanted) {
    wanted_.pop_front();
  }
  emit DetailsWanted();
}

QString MemberListModel::LastPlayedDate(const MemberHit& hit) const {
  const QString stored = QString::fromStdString(hit.LastPlayed);
  if (stored.isEmpty()) {
    return Text(strings_, OwnText::NeverPlayed);
  }
  const QDateTime time = QDateTime::fromString(stored, QStringLiteral("yyyy-MM-dd HH:mm:ss"));
  return time.isValid() ? QString::fromStdString(ShortDateText(QLocale::system(), time.date())) : stored;
}

QString MemberListModel::LastPlayedText(const MemberHit& hit) const {
  const QString date = LastPlayedDate(hit);
  return hit.LastPlayed.empty()
             ? date
             : QString::fromStdString(Filled(strings_.Text(OwnText::LastPlayedOn), {date.toStdString()}));
}

QString MemberListModel::SpokenText(Row& row) const {
  QStringList parts = {QString::fromStdString(row.Hit.Name())};
  if (!row.Hit.NickName.empty()) {
    parts << QString::fromStdString(row.Hit.NickName);
  }
  parts << LastPlayedText(row.Hit);
  if (SharesName(row)) {
    parts << Text(strings_, OwnText::SharedName);
  }
  return parts.join(QStringLiteral(", "));
}

QPixmap MemberListModel::PhotoOf(int row, const MemberHit& hit) const {
  if (const auto read = photos_.find(hit.ContactId); read != photos_.end()) {
    return read->second;
  }
  if (hit.HasPhoto) {
    WantDetails(row);
  }
  return {};
}
