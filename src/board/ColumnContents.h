#pragma once

#include <QString>
#include <optional>
#include <vector>

#include "board/TextWidths.h"

class QAbstractItemModel;

/// The widest texts in the columns of a ScoreListModel. Widths are those in letters of size 1.
class ColumnContents {
 public:
  struct Column {
    QString Text;  ///< the widest
    double Width = 0;
    QString Gun;  ///< the widest of a member, which stands in small letters
    double GunWidth = 0;
    double NameWidth = 0;    ///< of the members' names, as far as there should always be room for them
    double LongestName = 0;  ///< the whole width
  };

  /// `font` is the list's, of any size.
  void Measure(const QAbstractItemModel& model, const QFont& font);

  /// An empty one before the first measurement.
  const Column& operator[](int column) const;

 private:
  void Take(const QAbstractItemModel& model, int row, int column);

  std::vector<Column> columns_;
  std::optional<TextWidths> widths_;
};
