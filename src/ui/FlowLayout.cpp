#include "ui/FlowLayout.h"

#include <QWidget>
#include <algorithm>

FlowLayout::FlowLayout(QWidget* parent, const Gaps& gaps) : QLayout(parent), gaps_(gaps) {}

FlowLayout::~FlowLayout() {
  qDeleteAll(items_);
}

void FlowLayout::Join(const QWidget& widget, bool joins) {
  if (joins) {
    joined_.insert(&widget);
  } else {
    joined_.erase(&widget);
  }
}

QLayoutItem* FlowLayout::takeAt(int index) {
  return index >= 0 && index < items_.size() ? items_.takeAt(index) : nullptr;
}

int FlowLayout::heightForWidth(int width) const {
  const QMargins margins = contentsMargins();
  int height = margins.top() + margins.bottom() - gaps_.Lines;
  for (const Line& line : LinesIn(width - margins.left() - margins.right())) {
    height += line.Height + gaps_.Lines;
  }
  return height;
}

QSize FlowLayout::sizeHint() const {
  const QMargins margins = contentsMargins();
  int width = margins.left() + margins.right() - gaps_.Apart;
  for (const Group& group : Groups()) {
    width += WidthOf(group) + gaps_.Apart;
  }
  return {width, heightForWidth(width)};
}

// Of any width: what is too wide for a line of its own is cut, rather than the window made wider.
QSize FlowLayout::minimumSize() const {
  int height = 0;
  for (const QLayoutItem* item : items_) {
    if (!item->isEmpty()) {
      height = std::max(height, item->minimumSize().height());
    }
  }
  return QSize(0, height).grownBy(contentsMargins());
}

void FlowLayout::setGeometry(const QRect& place) {
  QLayout::setGeometry(place);
  const QRect inner = place.marginsRemoved(contentsMargins());
  int y = inner.y();
  for (const Line& line : LinesIn(inner.width())) {
    for (const Spot& spot : line.Spots) {
      spot.Item->setGeometry({inner.x() + spot.X, y, spot.Width, line.Height});
    }
    y += line.Height + gaps_.Lines;
  }
}

std::vector<FlowLayout::Group> FlowLayout::Groups() const {
  std::vector<Group> groups;
  for (QLayoutItem* item : items_) {
    if (item->isEmpty()) {
      continue;
    }
    if (groups.empty() || !joined_.contains(item->widget())) {
      groups.emplace_back();
    }
    groups.back().push_back(item);
  }
  return groups;
}

int FlowLayout::WidthOf(const Group& group) const {
  int width = -gaps_.Joined;
  for (const QLayoutItem* item : group) {
    width += item->sizeHint().width() + gaps_.Joined;
  }
  return width;
}

std::vector<FlowLayout::Line> FlowLayout::LinesIn(int width) const {
  std::vector<Line> lines(1);
  int x = 0;
  const auto makeRoom = [&](int needed) {
    if (x > 0 && x + needed > width) {
      lines.emplace_back();
      x = 0;
    }
  };
  for (const Group& group : Groups()) {
    makeRoom(WidthOf(group));
    for (QLayoutItem* item : group) {
      const int itsWidth = std::min(item->sizeHint().width(), width);
      makeRoom(itsWidth);
      Line& line = lines.back();
      line.Spots.push_back({item, x, itsWidth});
      line.Height = std::max(line.Height, item->sizeHint().height());
      x += itsWidth + gaps_.Joined;
    }
    x += gaps_.Apart - gaps_.Joined;
  }
  return lines;
}
