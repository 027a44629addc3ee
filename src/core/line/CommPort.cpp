#include "core/line/CommPort.h"

#include <utility>

#include "core/line/EnumPorts.h"
#include "core/text/NumberForms.h"
#include "platform/RuntimeError.h"

CommPort::CommPort(SerialPort& port, const IniReader& ini, const SerialDevices& devices, MessageBoxes& boxes,
                   const StringTable& strings, std::function<void()> showSettings)
    : port_(port),
      ini_(ini),
      devices_(devices),
      boxes_(boxes),
      strings_(strings),
      showSettings_(std::move(showSettings)) {}

bool CommPort::OpenCommPort(const std::string& settings) {
  for (;;) {
    CloseIfOpen();
    try {
      Open(settings);
      return true;
    } catch (const RuntimeError&) {
      const BoxAnswer answer =
          boxes_.Show(strings_.Text(121), strings_.Text(122), BoxIcon::Exclamation, BoxButtons::OkCancel);
      if (answer == BoxAnswer::Cancel) {
        commDisabled_ = true;
        return false;
      }
    }
    showSettings_();
  }
}

void CommPort::Open(const std::string& settings) {
  const std::int16_t number = ToInt16(ini_.ReadIni(Keys::CommPort));
  const std::string device = EnumPorts(ini_, devices_).DeviceOf(number);
  if (device.empty()) {
    throw RuntimeError(8002);
  }
  port_.Open(device, settings);
}

void CommPort::CloseIfOpen() {
  if (port_.PortOpen()) {
    port_.Close();
  }
}
