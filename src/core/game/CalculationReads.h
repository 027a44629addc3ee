#pragma once

#include <optional>
#include <string>

#include "platform/Database.h"
#include "platform/MessageBoxes.h"

class CalculationReads;

/// Shows boxes as `boxes` does, and releases the databases of a calculation while one is open: the operator
/// may take minutes to answer, and other programs need not wait for that.
class UnlockingBoxes : public MessageBoxes {
 public:
  explicit UnlockingBoxes(MessageBoxes& boxes) : boxes_(boxes) {}

  BoxAnswer Show(const std::string& text, const std::string& title, BoxIcon icon,
                 BoxButtons buttons = BoxButtons::Ok) override;

 private:
  friend class CalculationReads;

  MessageBoxes& boxes_;
  CalculationReads* reads_ = nullptr;  ///< those of the calculation that is running, none while a box is open
};

/// A read scope on both databases while it exists, except while one of `boxes` is open.
class CalculationReads {
 public:
  CalculationReads(Database& dbMembers, Database& dbScenarios, UnlockingBoxes& boxes);
  ~CalculationReads();
  CalculationReads(const CalculationReads&) = delete;
  CalculationReads& operator=(const CalculationReads&) = delete;

 private:
  friend class UnlockingBoxes;

  void Begin();
  void End();

  Database& dbMembers_;
  Database& dbScenarios_;
  UnlockingBoxes& boxes_;
  std::optional<ReadScope> members_;
  std::optional<ReadScope> scenarios_;
};
