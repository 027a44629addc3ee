#include "core/game/CalculationReads.h"

BoxAnswer UnlockingBoxes::Show(const std::string& text, const std::string& title, BoxIcon icon,
                               BoxButtons buttons) {
  if (silenced_) {
    return BoxAnswer::Ok;
  }
  CalculationReads* const reads = std::exchange(reads_, nullptr);
  if (reads == nullptr) {
    return boxes_.Show(text, title, icon, buttons);
  }
  reads->End();
  const BoxAnswer answer = boxes_.Show(text, title, icon, buttons);
  reads->Begin();
  return answer;
}

CalculationReads::CalculationReads(Database& dbMembers, Database& dbScenarios, UnlockingBoxes& boxes)
    : dbMembers_(dbMembers), dbScenarios_(dbScenarios), boxes_(boxes) {
  Begin();
}

CalculationReads::~CalculationReads() {
  boxes_.reads_ = nullptr;
}

void CalculationReads::Begin() {
  members_.emplace(dbMembers_);
  scenarios_.emplace(dbScenarios_);
  boxes_.reads_ = this;
}

void CalculationReads::End() {
  members_.reset();
  scenarios_.reset();
}
