#pragma once

#include <QDialog>
#include <memory>
#include <optional>

#include "core/game/Game.h"
#include "core/text/StringTable.h"
#include "devices/box/BoxProgrammer.h"
#include "platform/Clock.h"
#include "ui/Commands.h"
#include "ui/EntryChecks.h"
#include "ui/OutcomeSignals.h"

class QComboBox;

namespace Ui {
class BoxConfig;
}

/// Programs utility boxes, and lists those of this run of the program. The button stays enabled while a box
/// is awaited: pressed then, it sends again. If closed meanwhile, the window goes once the wait has unwound;
/// Escape does not close it then.
class BoxConfig : public QDialog {
  Q_OBJECT

 public:
  /// What the window works with; all of it must outlive the window.
  struct Parts {
    SerialPort& MSComm1;
    const CommPort& Port;
    EventPump& Events;
    MessageBoxes& Boxes;
    const Clock& Time;
    const StringTable& Strings;
    const ::Game& Game;
    ProgrammedBoxes& Programmed;
    OutcomeSignals::Parts Signals;
  };

  BoxConfig(const Parts& parts, QWidget* parent);
  ~BoxConfig() override;

  void reject() override;

 private:
  void FillLists();
  void SetUpResults();
  void SetUpTips();
  void SetUpChecks();
  std::optional<EntryFault> FaultOfBoxType();

  BoxEntries Entries() const;
  void Show(const BoxEntries& entries);
  void Program();
  void ProgramAgain(const BoxEntries& entries);
  /// Signals how a press ended and adds the box to the list.
  void Note(const BoxEntries& entries, BoxResult result);
  void AddRow(std::size_t number, const ProgrammedBox& box);

  std::unique_ptr<Ui::BoxConfig> ui_;
  const Parts parts_;
  Commands commands_;
  EntryChecks checks_;
  BoxProgrammer programmer_;
};
