#include "core/game/MissionList.h"

#include <utility>

#include "core/data/FieldValue.h"
#include "core/data/Rows.h"
#include "core/text/NumberForms.h"
#include "platform/RuntimeError.h"

void MissionList::FillMissionList() {
  std::vector<Item> items = {{strings_.Text(119), 0}, {strings_.Text(120), 0}};
  ForEachRow(rsScenarios_, [this, &items] {
    items.push_back(
        {TextOf(rsScenarios_.Fields("MissionName")), RoundToInt32(NumberOf(rsScenarios_.Fields("ID")))});
  });
  items_ = std::move(items);
  listIndex_ = None;
}

const std::string& MissionList::Text() const {
  return items_.at(static_cast<std::size_t>(listIndex_)).Text;
}

void MissionList::Select(int index) {
  if (index < 0 || index >= static_cast<int>(items_.size())) {
    throw RuntimeError(Fault::SubscriptOutOfRange);
  }
  listIndex_ = index;
}

bool MissionList::ActivateCurrentMissionRecord() {
  if (listIndex_ <= FreeForAll) {
    return false;
  }
  rsScenarios_.FindFirst("ID=" + Str(items_[static_cast<std::size_t>(listIndex_)].Id));
  if (!rsScenarios_.NoMatch()) {
    return true;
  }
  boxes_.Show(strings_.Text(101), strings_.Text(102), BoxIcon::Exclamation);
  return false;
}
