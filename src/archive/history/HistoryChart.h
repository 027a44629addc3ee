#pragma once

#include <QWidget>
#include <algorithm>
#include <optional>
#include <vector>

/// A value in a member's history.
struct HistoryPoint {
  QString Label = {};  ///< below the axis
  double Value = 0;
  std::optional<double> Mean = {};  ///< the line beside the values goes through these
  QString Text = {};                ///< tells all of it
};

/// Values in the order of time, as dots with the line of their means or as bars. What is below zero is
/// hollow. The pointer and the arrow keys go from one to the next.
class HistoryChart : public QWidget {
  Q_OBJECT

 public:
  enum class Kind { Curve, Bars };

  explicit HistoryChart(QWidget* parent = nullptr);

  /// Must be called first. `name` and `description` are for screen readers.
  void SetUp(Kind kind, const QString& name, const QString& description);

  /// The earliest first.
  void SetPoints(std::vector<HistoryPoint> points);

  /// The place of the one that is told at the moment.
  std::optional<int> Place() const { return place_; }
  /// Goes to one without telling it.
  void SetPlace(std::optional<int> place);

  /// Where a value is painted.
  QPointF SpotOf(int place) const;
  /// Where a bar is painted, down or up to zero.
  QRectF BarOf(int place) const;

  QSize sizeHint() const override { return {480, 200}; }
  QSize minimumSizeHint() const override { return {240, 110}; }

 signals:
  /// The operator went to one; by keys or a click if `chosen`, else with the pointer.
  void Told(const QString& text, bool chosen);

 protected:
  void paintEvent(QPaintEvent* event) override;
  void keyPressEvent(QKeyEvent* event) override;
  void mouseMoveEvent(QMouseEvent* event) override;
  void mousePressEvent(QMouseEvent* event) override;
  void focusInEvent(QFocusEvent* event) override;
  void focusOutEvent(QFocusEvent* event) override;

 private:
  int Count() const { return static_cast<int>(points_.size()); }
  const HistoryPoint& At(int place) const { return points_[static_cast<std::size_t>(place)]; }
  QRectF Area() const;
  double Step() const { return Area().width() / std::max(Count(), 1); }
  double HeightOf(double value) const;
  int PlaceAt(double x) const;
  void GoTo(int place, bool chosen);
  void DrawAxes(QPainter& painter) const;
  void DrawLabels(QPainter& painter) const;
  void DrawBars(QPainter& painter) const;
  void DrawCurve(QPainter& painter) const;

  Kind kind_ = Kind::Curve;
  std::vector<HistoryPoint> points_;
  double least_ = 0;  ///< the axis shows what lies between these
  double most_ = 1;
  double tick_ = 1;
  std::optional<int> place_;
};
