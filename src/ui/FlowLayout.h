#pragma once

#include <QLayout>
#include <QList>
#include <set>
#include <vector>

/// Places widgets from left to right and begins a new line where the next one does not fit. All widgets of a
/// line are as high as the line.
class FlowLayout : public QLayout {
 public:
  /// Pixels between widgets, between widgets that are joined, and between lines.
  struct Gaps {
    int Apart;
    int Joined;
    int Lines;
  };

  FlowLayout(QWidget* parent, const Gaps& gaps);
  ~FlowLayout() override;

  /// Keeps `widget` on one line with the widget before it, if they fit on one, or no longer does so.
  void Join(const QWidget& widget, bool joins);

  void addItem(QLayoutItem* item) override { items_.append(item); }
  int count() const override { return static_cast<int>(items_.size()); }
  QLayoutItem* itemAt(int index) const override { return items_.value(index); }
  QLayoutItem* takeAt(int index) override;

  Qt::Orientations expandingDirections() const override { return {}; }
  bool hasHeightForWidth() const override { return true; }
  int heightForWidth(int width) const override;
  QSize sizeHint() const override;
  QSize minimumSize() const override;
  void setGeometry(const QRect& place) override;

 private:
  using Group = std::vector<QLayoutItem*>;
  struct Spot {
    QLayoutItem* Item;
    int X;
    int Width;
  };
  struct Line {
    std::vector<Spot> Spots;
    int Height = 0;
  };

  /// The visible widgets, joined ones together.
  std::vector<Group> Groups() const;
  int WidthOf(const Group& group) const;
  /// The lines of a layout whose margins leave `width`.
  std::vector<Line> LinesIn(int width) const;

  const Gaps gaps_;
  QList<QLayoutItem*> items_;
  std::set<const QWidget*> joined_;
};
