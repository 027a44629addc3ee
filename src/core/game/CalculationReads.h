#pragma once

#include <optional>
#include <string>
#include <utility>

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
  friend class SilencedBoxes;

  MessageBoxes& boxes_;
  bool silenced_ = false;
  CalculationReads* reads_ = nullptr;  ///< those of the calculation that is running, none while a box is open
};

/// While it exists the boxes are not shown, and each counts as answered with OK.
class SilencedBoxes {
 public:
  explicit SilencedBoxes(UnlockingBoxes& boxes)
      : boxes_(boxes), before_(std::exchange(boxes.silenced_, true)) {}
  ~SilencedBoxes() { boxes_.silenced_ = before_; }
  SilencedBoxes(const SilencedBoxes&) = delete;
  SilencedBoxes& operator=(const SilencedBoxes&) = delete;

 private:
  UnlockingBoxes& boxes_;
  const bool before_;
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
