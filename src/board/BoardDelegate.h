#pragma once

#include <QStyledItemDelegate>

/// Paints the cells of a score list. A selected row keeps its team's colour, more strongly, and gets a frame.
/// There are no tool tips but for texts that are cut.
class BoardDelegate : public QStyledItemDelegate {
  Q_OBJECT

 public:
  using QStyledItemDelegate::QStyledItemDelegate;

  void paint(QPainter* painter, const QStyleOptionViewItem& option, const QModelIndex& index) const final;
  bool helpEvent(QHelpEvent* event, QAbstractItemView* view, const QStyleOptionViewItem& option,
                 const QModelIndex& index) override;

 protected:
  void initStyleOption(QStyleOptionViewItem* option, const QModelIndex& index) const override;

  /// Paints a cell that has been initialised.
  virtual void PaintCell(QPainter& painter, const QStyleOptionViewItem& cell, const QModelIndex& index) const;

  /// Paints all of a cell but its text.
  static void PaintGround(QPainter& painter, const QStyleOptionViewItem& cell);
  /// Paints a text in the middle of a cell's height. Its capitals decide, so that texts of all languages
  /// stand on one line.
  static void PaintText(QPainter& painter, const QStyleOptionViewItem& cell, const QString& text);

  /// True if the cell has no room for the whole of its text.
  virtual bool IsCut(const QStyleOptionViewItem& cell, const QModelIndex& index) const;

  /// Where the text stands in the cell.
  static QRect TextPlace(const QStyleOptionViewItem& cell);
};

/// Side of the badge beside letters whose capitals have this height.
int BadgeSize(double capitals);
