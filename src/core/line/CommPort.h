#pragma once

#include <functional>
#include <string>

#include "core/line/CommPortSetting.h"
#include "core/text/StringTable.h"
#include "platform/MessageBoxes.h"
#include "platform/SerialPort.h"

/// The serial line whose number the settings name, and the question to the operator when it does not open.
class CommPort {
 public:
  /// `showSettings` shows the settings window modally.
  CommPort(SerialPort& port, const IniReader& ini, const SerialDevices& devices, MessageBoxes& boxes,
           const StringTable& strings, std::function<void()> showSettings);

  /// Opens the line with `settings` ("19200,N,8,1"). While that fails the operator is asked: OK leads to the
  /// settings and another try. Returns false once Cancel was pressed.
  bool OpenCommPort(const std::string& settings);

  /// The device that the settings name now. Throws as CommPortSetting::Device does.
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
