#pragma once

#include <QAbstractListModel>
#include <QPixmap>
#include <QString>
#include <deque>
#include <optional>
#include <unordered_map>

#include "core/text/StringTable.h"
#include "members/MemberHits.h"

/// The members found, as rows of a list. A row is read when it is first shown; what takes longer, its photo
/// and whether others have the same name, later still by ReadNextDetails, so that nothing holds up the
/// operator's typing.
class MemberListModel : public QAbstractListModel {
  Q_OBJECT

 public:
  /// Beside the name (DisplayRole) and the photo (DecorationRole).
  enum Role {
    NickNameRole = Qt::UserRole,
    LastPlayedRole,      ///< text with the date of the last game
    LastPlayedDateRole,  ///< the date alone, or that there is none
    SharedNameRole,      ///< true once another member is known to have the same name
  };

  /// Both must outlive the model.
  MemberListModel(Database& dbMembers, const StringTable& strings, QObject* parent);

  /// Lists the members found for `text`.
  void Search(const std::string& text);
  /// The texts of the rows are read anew when they are next shown; the rows stay the same ones.
  void Refresh() { rows_.clear(); }
  /// The same for this member's photo, which was changed.
  void ForgetPhoto(std::int64_t contactId) {
    rows_.clear();
    photos_.erase(contactId);
  }

  /// Row of a member, -1 if the list lacks it.
  int RowOf(std::int64_t contactId) { return hits_.PositionOf(contactId); }
  /// `ContactID` of the member in `row`, 0 if the row is gone.
  std::int64_t MemberIn(int row);

  /// Reads the details of one of the rows that were shown without. Returns false if there is none left.
  bool ReadNextDetails();

  int rowCount(const QModelIndex& parent = {}) const override;
  QVariant data(const QModelIndex& index, int role) const override;

 signals:
  /// A row is shown whose details are still to be read.
  void DetailsWanted() const;

 private:
  struct Row {
    MemberHit Hit;
    std::optional<bool> SharesName;  ///< none while it is not known
  };

  Row& RowAt(int row) const;
  bool SharesName(Row& row) const;
  void WantDetails(int row) const;
  QString LastPlayedDate(const MemberHit& hit) const;
  QString LastPlayedText(const MemberHit& hit) const;
  QString SpokenText(Row& row) const;
  QPixmap PhotoOf(int row, const MemberHit& hit) const;

  const StringTable& strings_;
  mutable MemberHits hits_;
  int count_ = 0;
  mutable std::unordered_map<int, Row> rows_;                 ///< those read so far, by number
  mutable std::unordered_map<std::int64_t, QPixmap> photos_;  ///< by ContactID; null if it is no picture
  mutable std::deque<int> wanted_;                            ///< rows whose details are to be read
};
