#include "board/ColumnContents.h"

#include <QAbstractItemModel>
#include <algorithm>

#include "board/ScoreListModel.h"

namespace {

/// Letters of a name, each as wide as high, for which there should be room.
constexpr double RoomForName = 5;

}  // namespace

void ColumnContents::Measure(const QAbstractItemModel& model, const QFont& font) {
  if (!widths_) {
    widths_.emplace(font);
  }
  columns_.assign(static_cast<std::size_t>(model.columnCount()), {});
  for (int row = 0; row < model.rowCount(); ++row) {
    for (int column = 0; column < model.columnCount(); ++column) {
      Take(model, row, column);
    }
  }
}

void ColumnContents::Take(const QAbstractItemModel& model, int row, int column) {
  Column& contents = columns_[static_cast<std::size_t>(column)];
  const QModelIndex index = model.index(row, column);
  const QString member = index.data(ScoreListModel::MemberNameRole).toString();
  if (member.isEmpty()) {
    const QString text = index.data().toString();
    if (const double width = widths_->Of(text); width > contents.Width) {
      contents.Width = width;
      contents.Text = text;
    }
    return;
  }
  contents.LongestName = std::max(contents.LongestName, widths_->Of(member));
  contents.NameWidth = std::min(contents.LongestName, RoomForName);
  const QString gun = index.data(ScoreListModel::NameRole).toString();
  if (const double width = widths_->Of(gun); width > contents.GunWidth) {
    contents.GunWidth = width;
    contents.Gun = gun;
  }
}

const ColumnContents::Column& ColumnContents::operator[](int column) const {
  static const Column none;
  return static_cast<std::size_t>(column) < columns_.size() ? columns_[static_cast<std::size_t>(column)]
                                                            : none;
}
