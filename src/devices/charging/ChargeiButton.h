#pragma once

#include <QDialog>
#include <memory>

#include "core/text/StringTable.h"
#include "devices/charging/ButtonCharger.h"
#include "ui/Commands.h"
#include "ui/OutcomeSignals.h"
#include "ui/PollTimer.h"

namespace Ui {
class ChargeiButton;
}

/// Charges the buttons that the operator touches to the reader, and lists those of this run of the program.
class ChargeiButton : public QDialog, private ChargingDisplay {
  Q_OBJECT

 public:
  /// What the window works with; all of it must outlive the window.
  struct Parts {
    OneWire& Wire;
    EventPump& Events;
    MessageBoxes& Boxes;
    const Clock& Time;
    const StringTable& Strings;
    ChargedButtons& Charged;
    OutcomeSignals::Parts Signals;
  };

  ChargeiButton(const Parts& parts, QWidget* parent);
  ~ChargeiButton() override;

  void reject() override;

 private:
  void SetUpResults();
  void Tick();
  void AddRow(std::size_t number, const ChargedButton& button);
  QString KindOf(const ChargedButton& button) const;

  void SetStatus(const std::string& text) override;
  void BeginButton() override;
  void ButtonsLeft() override { parts_.Charged.BeginTouch(); }
  void SetReader(bool present) override;
  void Note(const ChargedButton& button) override;
  bool Closing() const override { return commands_.CloseRequested(); }

  std::unique_ptr<Ui::ChargeiButton> ui_;
  const Parts parts_;
  ButtonCharger charger_;
  Commands commands_;
  PollTimer* timer1_;
};
