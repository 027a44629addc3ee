#pragma once

#include <chrono>
#include <cstdint>
#include <string>
#include <vector>

#include "core/line/CommPort.h"
#include "tests/fakes/FakeClock.h"
#include "tests/fakes/FakeEventPump.h"
#include "tests/fakes/FakeFiles.h"
#include "tests/fakes/FakeMessageBoxes.h"
#include "tests/fakes/FakeSerialDevices.h"
#include "tests/fakes/FakeSerialPort.h"

/// A serial line with a utility box at its far end, port 1 of two.
struct BoxSite {
  FakeFiles Store;
  FakeSerialDevices Devices;
  FakeSerialPort Port;
  FakeMessageBoxes Boxes;
  FakeEventPump Events;
  FakeClock Time;
  StringTable Strings;
  IniReader Ini{Store, "/tessarine.ini"};
  CommPort Line{Port, Ini, Devices, Boxes, Strings, [] {}};

  explicit BoxSite(Language language = Language::English) : Strings(language) {
    Devices.Ports = {"/dev/ttyS0", "/dev/ttyUSB0"};
  }
  BoxSite(const BoxSite&) = delete;
  BoxSite& operator=(const BoxSite&) = delete;

  /// Each whole frame is answered by `bytes` after `delay` ms.
  void AnswerWith(const std::vector<std::uint8_t>& bytes, int delay = 20) {
    Port.OnOutput = [this, bytes, delay](std::uint8_t) {
      if (Port.Sent.size() % 10 == 0) {
        Events.At(std::chrono::milliseconds(delay), [this, bytes] { Port.Receive(bytes); });
      }
    };
  }

  /// Does `act` in the middle of the wait.
  void Meanwhile(int delay, std::function<void()> act) {
    Events.At(std::chrono::milliseconds(delay), std::move(act));
  }

  static FakeMessageBoxes::Box Successful() {
    return {"Programming Successful", "Orvalin Box Config", BoxIcon::Information};
  }
  static FakeMessageBoxes::Box RejectedByBox() {
    return {"Programming rejected by Box, please check values and try again", "Orvalin Box Config",
            BoxIcon::Exclamation};
  }
  static FakeMessageBoxes::Box NoResponse() {
    return {"No response from Box, please check serial connection and try again.", "Communications Error",
            BoxIcon::None};
  }
  static FakeMessageBoxes::Box PortError() {
    return {"Comm port error.", "Comms error", BoxIcon::Exclamation};
  }
  static FakeMessageBoxes::Box PortTaken() {
    return {"Could not access Comms port", "Comms error", BoxIcon::Exclamation};
  }
};
