#include "charts/ChartKeys.h"

#include <Qt>
#include <algorithm>

std::optional<int> PlaceByKey(int key, int from, int count, ChartOrder order) {
  constexpr int page = 10;
  const bool isAcross = order == ChartOrder::Across;
  int place = from;
  if (key == (isAcross ? Qt::Key_Left : Qt::Key_Up)) {
    --place;
  } else if (key == (isAcross ? Qt::Key_Right : Qt::Key_Down)) {
    ++place;
  } else if (key == Qt::Key_PageUp) {
    place -= page;
  } else if (key == Qt::Key_PageDown) {
    place += page;
  } else if (key == Qt::Key_Home) {
    place = 0;
  } else if (key == Qt::Key_End) {
    place = count - 1;
  } else {
    return std::nullopt;
  }
  return std::clamp(place, 0, count - 1);
}
