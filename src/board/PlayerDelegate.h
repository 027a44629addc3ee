#pragma once

#include <QFontMetrics>
#include <QStyledItemDelegate>

/// Name of a gun, like "Yellow 24", made to fit `width` pixels: the team's name is cut, never the number.
QString FittingGunName(const QString& name, const QFontMetrics& metrics, int width);

/// Shows a player of a ScoreListModel with the member's name in small letters below, since the two do not fit
/// side by side in the board's column.
class PlayerDelegate : public QStyledItemDelegate {
  Q_OBJECT

 public:
  using QStyledItemDelegate::QStyledItemDelegate;

  void paint(QPainter* painter, const QStyleOptionViewItem& option, const QModelIndex& index) const override;

 protected:
  void initStyleOption(QStyleOptionViewItem* option, const QModelIndex& index) const override;
};
