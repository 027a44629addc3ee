#pragma once

#include <cstdint>
#include <string>
#include <vector>

#include "core/text/StringTable.h"
#include "platform/Database.h"
#include "platform/MessageBoxes.h"

/// The missions to play: "None", "Free For All", then the rows of the mission table; and which of them is
/// active.
class MissionList {
 public:
  struct Item {
    std::string Text;
    std::int32_t Id;  ///< `ID` of the mission's row; 0 for the two fixed entries
  };

  static constexpr int None = 0;
  static constexpr int FreeForAll = 1;

  MissionList(Recordset& rsScenarios, const StringTable& strings, MessageBoxes& boxes)
      : rsScenarios_(rsScenarios), strings_(strings), boxes_(boxes) {}

  /// Reads the list anew. The active mission is "None" afterwards.
  void FillMissionList();

  const std::vector<Item>& Items() const { return items_; }

  int ListIndex() const { return listIndex_; }
  /// Text of the active entry.
  const std::string& Text() const;
  /// Makes entry `index` (0 to the number of entries - 1, else RuntimeError 9) the active one.
  void Select(int index);

  /// Moves the mission cursor to the active mission's row. False when the active entry is a fixed one, or
  /// when the row is gone, which is said in a box.
  bool ActivateCurrentMissionRecord();

  Recordset& Row() { return rsScenarios_; }

 private:
  Recordset& rsScenarios_;
  const StringTable& strings_;
  MessageBoxes& boxes_;
  std::vector<Item> items_;
  int listIndex_ = None;
};
