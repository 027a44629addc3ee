#pragma once

#include <QStyledItemDelegate>

/// Shows a player of a ScoreListModel with the member's name in small letters below, since the two do not fit
/// side by side in the board's column.
class PlayerDelegate : public QStyledItemDelegate {
  Q_OBJECT

 public:
  using QStyledItemDelegate::QStyledItemDelegate;

  void paint(QPainter* painter, const QStyleOptionViewItem& option, const QModelIndex& index) const override;
};
