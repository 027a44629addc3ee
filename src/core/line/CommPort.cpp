#include "core/line/CommPort.h"

#include <utility>

#include "platform/RuntimeError.h"

CommPort::CommPort(SerialPort& port, const IniReader& ini, const SerialDevices& devices, MessageBoxes& boxes,
                   const StringTable& strings, std::function<void()> showSettings)
    : port_(port),
      setting_(ini, devices),
      boxes_(boxes),
      strings_(strings),
      showSettings_(std::move(showSettings)) {}

bool CommPort::OpenCommPort(const std::string& settings) {
  for (;;) {
    CloseIfOpen();
    try {
      port_.Open(Device(), settings);
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

void CommPort::CloseIfOpen() {
  if (port_.PortOpen()) {
    port_.Close();
  }
}
