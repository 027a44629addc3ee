#pragma once

#include <QDialog>
#include <memory>

#include "core/text/StringTable.h"
#include "platform/MessageBoxes.h"
#include "sheets/PrintChoice.h"

namespace Ui {
class PrintOptions;
}

/// Asks which score sheets are wanted and where they go. It is hidden and not closed, so that it shows the
/// last choices when it is shown again.
class PrintOptions : public QDialog {
  Q_OBJECT

 public:
  PrintOptions(const StringTable& strings, MessageBoxes& boxes, QWidget* parent);
  ~PrintOptions() override;

  /// What was chosen; `SheetSelection` is 0 after Cancel.
  const PrintChoice& Choice() const { return choice_; }

  void accept() override;
  void reject() override;

 private:
  void FillLists(const StringTable& strings);
  /// Only the lists of the option that is set can be used.
  void EnableLists();

  std::unique_ptr<Ui::PrintOptions> ui_;
  MessageBoxes& boxes_;
  PrintChoice choice_;
};
