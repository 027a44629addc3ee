#pragma once

#include <QFontMetrics>

#include "board/BoardDelegate.h"

/// Name of a gun, like "Yellow 24", made to fit `width` pixels: the team's name is cut, never the number.
QString FittingGunName(const QString& name, const QFontMetrics& metrics, int width);

/// Size of a gun's name above the name of its member, relative to the letters of the board. `growth` is how
/// much larger these are than the smallest.
double GunSize(double growth);

/// The same in a row of this height, smaller where gun and name would touch. `font` is that of the smallest
/// letters, and `letters` are some of the operator's language: Chinese ones are higher than capitals.
double GunSizeIn(int rowHeight, double growth, const QFont& font, const QString& letters);

/// Height of a row of the smallest letters in which gun and name of a member do not touch.
int LeastRowOfMember(const QFont& font, const QString& letters);

/// Shows a player of a ScoreListModel: a member by name in full size with the gun in small letters above,
/// any other by the gun.
class PlayerDelegate : public BoardDelegate {
  Q_OBJECT

 public:
  using BoardDelegate::BoardDelegate;

  QSize sizeHint(const QStyleOptionViewItem& option, const QModelIndex& index) const override;

 protected:
  void initStyleOption(QStyleOptionViewItem* option, const QModelIndex& index) const override;
  void PaintCell(QPainter& painter, const QStyleOptionViewItem& cell,
                 const QModelIndex& index) const override;
  bool IsCut(const QStyleOptionViewItem& cell, const QModelIndex& index) const override;
};
