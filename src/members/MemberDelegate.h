#pragma once

#include <QStyledItemDelegate>

/// Paints a member of the list: the photo, the name with the nickname and the last game below it, and a mark
/// behind a name that several members have.
class MemberDelegate : public QStyledItemDelegate {
 public:
  using QStyledItemDelegate::QStyledItemDelegate;

  /// What stands below the name in `width` units. Where that is narrow, the last game is its date alone, and
  /// then the nickname is cut; if little of it would be left, it stands there without the date.
  static QString DetailsText(const QModelIndex& index, const QFontMetrics& letters, int width);

  void paint(QPainter* painter, const QStyleOptionViewItem& option, const QModelIndex& index) const override;
  QSize sizeHint(const QStyleOptionViewItem& option, const QModelIndex& index) const override;
};
