#pragma once

#include <QDialog>
#include <QElapsedTimer>
#include <memory>
#include <string>
#include <vector>

#include "check/SystemChecks.h"
#include "platform/EventPump.h"
#include "platform/MessageBoxes.h"
#include "ui/Commands.h"

namespace Ui {
class SystemCheck;
}

/// What the program needs of the computer, and for each matter that it is fine or what to do. The table fills
/// while the window is open; the report of it can be passed on.
class SystemCheck : public QDialog {
  Q_OBJECT

 public:
  struct Parts {
    const SystemChecks& Checks;
    const StringTable& Strings;
    MessageBoxes& Boxes;
    EventPump& Events;
    std::vector<std::string> Facts;  ///< about program and system, for the report
  };

  SystemCheck(Parts parts, QWidget* parent);
  ~SystemCheck() override;

  void reject() override;

 private:
  void Run();
  bool KeepOn();
  void Add(const CheckItem& item);
  void CopyReport();
  void ShowStatus(const QString& text);

  std::unique_ptr<Ui::SystemCheck> ui_;
  const Parts parts_;
  Commands commands_;
  std::vector<CheckItem> items_;
  QElapsedTimer sinceEvents_;
  bool stop_ = false;
};
