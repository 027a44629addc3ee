#pragma once

#include <cstdint>
#include <string>
#include <vector>

#include "core/text/StringTable.h"
#include "platform/Database.h"
#include "platform/MessageBoxes.h"

/// The missions to choose from: "None", "Free For All", then the rows of the mission table; and the active
/// one.
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

  /// Reloads the list. The active mission is "None" afterwards. A failure changes neither.
  void FillMissionList();

  const std::vector<Item>& Items() const { return items_; }

  int ListIndex() const { return listIndex_; }
  /// Text of the active entry.
  const std::string& Text() const;
  /// Makes entry `index`, counted from 0, the active one. Throws RuntimeError 9 if there is no such entry.
  void Select(int index);

  /// Moves the mission cursor to the active mission's row. False if the active entry is one of the two fixed
  /// ones, or if the row is gone, which a box reports.
  bool ActivateCurrentMissionRecord();

  Recordset& Row() { return rsScenarios_; }

 private:
  Recordset& rsScenarios_;
  const StringTable& strings_;
  MessageBoxes& boxes_;
  std::vector<Item> items_;
  int listIndex_ = None;
};
