#pragma once

#include <QImage>
#include <QWidget>
#include <optional>
#include <vector>

#include "charts/ScoreParts.h"
#include "core/text/StringTable.h"

/// A bar for each player, stacked by what the points come from: to the right of zero what gave points, to the
/// left what took some, and a mark at the score. The pointer and the arrow keys go from player to player.
class ScoreChart : public QWidget {
  Q_OBJECT

 public:
  explicit ScoreChart(QWidget* parent = nullptr);

  /// Must be called first; `strings` must outlive this.
  void SetUp(const StringTable& strings);

  /// The player who is told stays the same place if there still is one.
  void SetPlayers(std::vector<PlayerParts> players);
  const std::vector<PlayerParts>& Players() const { return players_; }

  /// The place from the top of the player who is told at the moment.
  std::optional<int> Place() const { return place_; }
  /// Goes to a player without telling them.
  void SetPlace(std::optional<int> place);

  /// Where a player's row is painted, and one of their parts; empty for a part that they do not have.
  QRect RowOf(int place) const;
  QRectF AreaOf(int place, ScorePart part) const;

  /// "Blue  7: Soldiering 289 = Damage 240, Accuracy 50, ..."
  QString TextOf(int place) const;

  /// All bars on white with their key.
  QImage Picture(const QString& title) const;

  QSize sizeHint() const override;

 signals:
  /// The operator went to a player; by keys or a click if `chosen`, else with the pointer.
  void Told(const QString& text, bool chosen);
  /// This row is to be in view.
  void Reached(const QRect& row);

 protected:
  void paintEvent(QPaintEvent* event) override;
  void changeEvent(QEvent* event) override;
  void keyPressEvent(QKeyEvent* event) override;
  void mouseMoveEvent(QMouseEvent* event) override;
  void mousePressEvent(QMouseEvent* event) override;
  void focusInEvent(QFocusEvent* event) override;
  void focusOutEvent(QFocusEvent* event) override;

 private:
  /// Where names, bars and totals lie, and how long a hundredth of a point is.
  struct Scale {
    double Names;
    double Zero;
    double Unit;
    double Right;
  };
  Scale ScaleFor(double width) const;
  int Pitch() const;
  int RowAt(double y) const;
  QRectF AreaOf(int place, ScorePart part, const Scale& scale) const;
  QString PartText(int place, ScorePart part) const;
  void GoTo(int place, bool chosen);
  void DrawRow(QPainter& painter, int place, const Scale& scale, const QColor& ink) const;

  const StringTable* strings_ = nullptr;
  std::vector<PlayerParts> players_;
  std::optional<int> place_;
};
