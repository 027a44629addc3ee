#pragma once

#include <functional>
#include <string>

#include "core/line/CommPortSetting.h"
#include "core/text/StringTable.h"
#include "platform/MessageBoxes.h"
#include "platform/SerialPort.h"

/// The serial port chosen in the settings, and the question to the operator if it does not open.
class CommPort {
 public:
  /// `showSettings` shows the settings window modally.
  CommPort(SerialPort& port, const IniReader& ini, const SerialDevices& devices, MessageBoxes& boxes,
           const StringTable& strings, std::function<void()> showSettings);

  /// Opens the line with `settings` ("19200,N,8,1"). If that fails, the operator is asked: OK shows the
  /// settings and tries again, Cancel returns false.
  bool OpenCommPort(const std::string& settings);

  /// The device currently chosen in the settings. Throws as CommPortSetting::Device does.
  std::string Device() const { return setting_.Device(); }

  void CloseIfOpen();

  /// True once the operator pressed Cancel at the port question.
  bool CommDisabled() const { return commDisabled_; }

 private:
  SerialPort& port_;
  CommPortSetting setting_;
  MessageBoxes& boxes_;
  const StringTable& strings_;
  std::function<void()> showSettings_;
  bool commDisabled_ = false;
};
