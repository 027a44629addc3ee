#pragma once

#include <functional>
#include <string>

#include "firmware/pic24f/PicComms.h"
#include "firmware/pic24f/SerialPicBoot.h"
#include "firmware/pic24f/tool/ScratchImages.h"
#include "firmware/pic24f/tool/ToolOptions.h"
#include "firmware/pic24f/tool/ToolParts.h"
#include "platform/EventPump.h"
#include "platform/SerialPort.h"

/// One conversation of the program with a device. What goes wrong is said on the standard error.
class DeviceSession {
 public:
  struct Parts {
    ToolParts Tool;
    SerialPort& Line;
    EventPump& Events;
    BootFolder Folder;  ///< of the ini file
    std::function<std::string(const std::string& port)> DeviceOf;
    /// How often the user has asked to stop: once ends an operation after the present block, twice at once.
    /// As long as nothing was changed, once ends it at once.
    std::function<int()> StopRequests;
    /// May be empty.
    std::function<void(std::size_t done, std::size_t whole)> ShowProgress = {};
  };

  /// Code of a command that is refused before anything is changed.
  static constexpr std::int32_t Refused = 0;

  /// Both must outlive the session.
  DeviceSession(const Parts& parts, const ToolOptions& options);

  /// Runs the command of the options; returns its code. For identify that is the identity. May throw
  /// RuntimeError; TellState says then, too, how the device is left.
  std::int32_t Run();

  /// Says in what state a command that ended with `code`, or with an exception, leaves the device.
  void TellState(std::int32_t code) const;

  /// What was printed after the code: warnings of a file that was refused, lines about the device.
  const std::vector<LostStretch>& Warnings() const { return warnings_; }
  const std::string& Facts() const { return facts_; }

 private:
  enum class State { Untouched, PartlyErased, PartlyWritten, Unconfirmed };

  bool ImportFile();
  std::int32_t Converse();
  std::int32_t Identify();
  bool FindDevice();
  std::int32_t Erase();
  std::int32_t Write();
  std::int32_t Verify();
  void ReadSettings();
  bool StopAsked() const;
  void ObeyStop();
  void PrintDifferences();

  const Parts& parts_;
  const ToolOptions& options_;
  ScratchImages images_;
  const BootIni ini_;
  SerialPicBoot library_;
  PicComms comms_;
  std::vector<LostStretch> warnings_;
  bool hasEeData_ = false;
  std::string facts_;
  State state_ = State::Untouched;
};
