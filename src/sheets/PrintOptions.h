#pragma once

#include <QDialog>
#include <memory>

#include "core/text/StringTable.h"
#include "platform/MessageBoxes.h"
#include "sheets/PrintChoice.h"

namespace Ui {
class PrintOptions;
}

/// Asks which score sheets to make and where to send them. The window is hidden, not closed, so that it shows
/// the last choices the next time.
class PrintOptions : public QDialog {
  Q_OBJECT

 public:
  PrintOptions(const StringTable& strings, MessageBoxes& boxes, QWidget* parent);
  ~PrintOptions() override;

  /// The operator's choice; `SheetSelection` is 0 after Cancel.
  const PrintChoice& Choice() const { return choice_; }

  void accept() override;
  void reject() override;

 private:
  void FillLists(const StringTable& strings);
  /// Enables only the lists that belong to the checked option.
  void EnableLists();

  std::unique_ptr<Ui::PrintOptions> ui_;
  MessageBoxes& boxes_;
  PrintChoice choice_;
};
