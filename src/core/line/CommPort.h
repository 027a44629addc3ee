#pragma once

#include <functional>
#include <string>

#include "core/data/IniReader.h"
#include "core/text/StringTable.h"
#include "platform/MessageBoxes.h"
#include "platform/SerialDevices.h"
#include "platform/SerialPort.h"

/// The serial line whose number the settings name.
class CommPort {
 public:
  /// `showSettings` shows the settings window modally.
  CommPort(SerialPort& port, const IniReader& ini, const SerialDevices& devices, MessageBoxes& boxes,
           const StringTable& strings, std::function<void()> showSettings);

  /// Opens the line with `settings` ("19200,N,8,1"). While that fails the operator is asked: OK leads to the
  /// settings and another try. Returns false once Cancel was pressed.
  bool OpenCommPort(const std::string& settings);

  /// Opens the line, which must be closed, once and without a question. Throws RuntimeError: as
  /// SerialPort::Open does, 8002 for a number without a device, 13 or 6 for a setting that is no number.
  void Open(const std::string& settings);

  void CloseIfOpen();

  /// True once the operator pressed Cancel at the port question.
  bool CommDisabled() const { return commDisabled_; }

 private:
  SerialPort& port_;
  const IniReader& ini_;
  const SerialDevices& devices_;
  MessageBoxes& boxes_;
  const StringTable& strings_;
  std::function<void()> showSettings_;
  bool commDisabled_ = false;
};
