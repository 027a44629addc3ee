#pragma once

#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

#include "core/data/LogRing.h"
#include "platform/Clock.h"
#include "platform/Files.h"

/// What the program did, step by step, for whoever has to find out later what happened at a venue: a row for
/// each step, with date and time, in `logs/program.log` in the user's data folder. Safe to pass on: it has
/// neither names of members nor numbers of their buttons. Rows that cannot be written are dropped.
class ProgramLog {
 public:
  static constexpr std::uint64_t FileBytes = 1U << 20U;  ///< of each of the ring's two files

  /// `dataFolder` need not exist yet: rows wait for it. The others must outlive the log.
  ProgramLog(Files& disk, const Clock& time, std::string dataFolder);

  /// The program has started; `facts` describe it and its system.
  void Started(const std::vector<std::string>& facts);

  /// The operator gave a command: the name of its menu item or button.
  void Command(std::string_view name);

  void BoxOpened(std::string_view title, std::string_view text);
  void BoxClosed(std::string_view answer);

  /// A failure reported to the operator; the row also names the latest command.
  void Fault(std::string_view text);

  /// An attempt to open a serial port; `fault` is 0 if it succeeded, otherwise the error number.
  void PortOpening(std::string_view device, std::string_view settings, int fault);

  void Ended(int exitCode);

 private:
  void Write(std::string_view kind, std::string_view text);

  Files& disk_;
  const Clock& time_;
  std::string dataFolder_;
  LogRing ring_;
  std::string waiting_;  ///< rows from before there was a data folder
  std::string latestCommand_;
};
