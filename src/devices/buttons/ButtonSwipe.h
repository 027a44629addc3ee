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

/// Asks for a membership button and goes as soon as one was read. Cancel, Escape and the close box let it go
/// at the end of the next look at the reader.
class ButtonSwipe : public QDialog {
  Q_OBJECT

 public:
  /// `wire` and `boxes` must outlive the window.
  ButtonSwipe(OneWire& wire, MessageBoxes& boxes, const StringTable& strings, QWidget* parent);
  ~ButtonSwipe() override;

  /// The button that was read since the window last came up; NoDallasId without one.
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
