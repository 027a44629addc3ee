#pragma once

#include <exception>
#include <new>
#include <string>

#include "platform/MessageBoxes.h"
#include "platform/RuntimeError.h"

/// How every error report begins; the number follows.
inline constexpr const char* ErrorReportStart = "Run-time error '";

inline void ShowErrorReport(MessageBoxes& boxes, int number, const std::string& text) {
  boxes.Show(ErrorReportStart + std::to_string(number) + "': " + text, DefaultBoxTitle, BoxIcon::Critical);
}

/// Runs one of the operator's commands. A failure that is not handled inside ends the command with a box; the
/// program continues. Returns false if the command failed.
template <typename Command>
bool ReportErrors(MessageBoxes& boxes, Command&& command) {
  try {
    command();
    return true;
  } catch (const RuntimeError& error) {
    ShowErrorReport(boxes, error.Number(), error.what());
  } catch (const std::bad_alloc&) {
    ShowErrorReport(boxes, Fault::OutOfMemory, std::string(Fault::TextOf(Fault::OutOfMemory)));
  } catch (const std::exception& error) {
    ShowErrorReport(boxes, Fault::InternalError,
                    std::string(Fault::TextOf(Fault::InternalError)) + ": " + error.what());
  }
  return false;
}
