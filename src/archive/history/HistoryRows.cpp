#include "archive/history/HistoryRows.h"

#include <algorithm>
#include <utility>

void HistoryRows::Show(int rows, TextOf textOf) {
  beginResetModel();
  rows_ = rows;
  textOf_ = std::move(textOf);
  endResetModel();
}

bool HistoryRows::IsText(int column) const {
  return std::ranges::find(textColumns_, column) != textColumns_.end();
}
