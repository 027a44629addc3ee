#pragma once

#include <string>

#include "core/data/ProgramLog.h"
#include "platform/MessageBoxes.h"

/// Message boxes that are recorded in the program's log, with the operator's answers. An error report is
/// logged as a fault.
class LoggedBoxes : public MessageBoxes {
 public:
  /// Both must outlive this object.
  LoggedBoxes(MessageBoxes& boxes, ProgramLog& log) : boxes_(boxes), log_(log) {}

  BoxAnswer Show(const std::string& text, const std::string& title, BoxIcon icon,
                 BoxButtons buttons = BoxButtons::Ok) override;

 private:
  MessageBoxes& boxes_;
  ProgramLog& log_;
};
