#pragma once

#include <QDialog>
#include <memory>

#include "core/text/StringTable.h"
#include "devices/buttons/ButtonReader.h"
#include "ui/Commands.h"
#include "ui/PollTimer.h"

namespace Ui {
class ButtonSwipe;
}

/// Asks for a membership button and closes as soon as one has been read. After Cancel, Escape or the close
/// box it polls the reader once more and then closes.
class ButtonSwipe : public QDialog {
  Q_OBJECT

 public:
  /// `wire` and `boxes` must outlive the window.
  ButtonSwipe(OneWire& wire, MessageBoxes& boxes, const StringTable& strings, QWidget* parent);
  ~ButtonSwipe() override;

  /// The button read since the window was last opened, or NoDallasId.
  const std::string& DallasID() const { return reader_.DallasID(); }

  void reject() override;

 protected:
  void showEvent(QShowEvent* event) override;

 private:
  void Tick();

  std::unique_ptr<Ui::ButtonSwipe> ui_;
  ButtonReader reader_;
  Commands commands_;
  PollTimer* timer1_;
};
