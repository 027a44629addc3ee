#pragma once

#include <string>

#include "core/text/StringTable.h"
#include "platform/Files.h"
#include "platform/MessageBoxes.h"
#include "takeover/TakeOverMark.h"

/// How a start of the program goes on behind a take-over that was interrupted.
struct ResumedTakeOver {
  bool GoOn = true;    ///< false if the operator ends the program
  std::string ToTell;  ///< for the operator, without haste; empty if there is nothing
};

/// Finishes a take-over that was marked, or deletes what one left that was not; to be called before any file
/// of the data folder is opened or made. One that can never be finished is taken back if it has exchanged no
/// file yet; otherwise the operator is asked whether to go on with the data as it is. Does nothing where
/// there is no data folder. Throws RuntimeError if the mark cannot be taken back.
ResumedTakeOver ResumeTakeOver(Files& disk, const std::string& dataFolder, MessageBoxes& boxes,
                               const StringTable& strings, const Breathe& breathe = {});
