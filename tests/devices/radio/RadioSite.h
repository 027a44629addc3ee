#pragma once

#include <chrono>
#include <cstddef>
#include <cstdint>
#include <functional>
#include <initializer_list>
#include <string>
#include <vector>

#include "core/line/CommPort.h"
#include "devices/radio/RadioDisplay.h"
#include "tests/fakes/FakeClock.h"
#include "tests/fakes/FakeEventPump.h"
#include "tests/fakes/FakeFiles.h"
#include "tests/fakes/FakeMessageBoxes.h"
#include "tests/fakes/FakeSerialDevices.h"
#include "tests/fakes/FakeSerialPort.h"
#include "tests/support/Frames.h"

inline Bytes Joined(std::initializer_list<Bytes> parts) {
  Bytes all;
  for (const Bytes& part : parts) {
    all.insert(all.end(), part.begin(), part.end());
  }
  return all;
}

/// A modem's frame with this body.
inline Bytes Framed(const Bytes& body) {
  unsigned int sum = 0;
  for (const std::uint8_t byte : body) {
    sum += byte;
  }
  return Joined(
      {{0x7E, static_cast<std::uint8_t>(body.size() / 256), static_cast<std::uint8_t>(body.size() % 256)},
       body,
       {static_cast<std::uint8_t>(0xFF - sum % 256)}});
}

/// Data that came by air from the modem whose address ends in `modem`.
inline Bytes Received(std::uint8_t modem, const Bytes& data) {
  return Framed(Joined({{0x80, 0, 0x13, 0xA2, 0, 0x40, 1, 2, modem, 40, 0}, data}));
}

inline Bytes ModemStatusFrame() {
  return {0x7E, 0, 2, 0x8A, 6, 0x6F};
}

inline Bytes TransmitStatusFrame() {
  return {0x7E, 0, 3, 0x89, 0, 0, 0x76};
}

/// Answer to the search: firmware 2.5, 85 percent, weapon 1.
inline Bytes SearchAnswer(std::uint8_t playerId) {
  return {4, playerId, 0, 0, 7, 2, 5, 85, 1};
}

/// A serial line with a modem and, in the air behind it, whatever a test makes of `OnPacket`.
struct RadioSite {
  std::vector<Bytes> Frames;                                         ///< all frames sent by the program
  std::function<void(const Bytes&)> OnPacket = [](const Bytes&) {};  ///< a gun packet goes out

  FakeFiles Store;
  FakeSerialDevices Devices;
  FakeSerialPort Port;
  FakeMessageBoxes Boxes;
  FakeEventPump Events;
  FakeClock Time;
  StringTable Strings;
  IniReader Ini{Store, "/tessarine.ini"};
  CommPort Line{Port, Ini, Devices, Boxes, Strings, [] {}};

  explicit RadioSite(Language language = Language::English) : Strings(language) {
    Devices.Ports = {"/dev/ttyS0", "/dev/ttyUSB0"};
    Port.OnOutput = [this](std::uint8_t byte) { Take(byte); };
  }
  RadioSite(const RadioSite&) = delete;
  RadioSite& operator=(const RadioSite&) = delete;

  /// These bytes arrive after `delay` ms.
  void Arrive(int delay, const Bytes& bytes) {
    Events.At(std::chrono::milliseconds(delay), [this, bytes] { Port.Receive(bytes); });
  }

  /// Gun packets sent so far.
  std::vector<Bytes> Packets() const {
    std::vector<Bytes> packets;
    for (const Bytes& frame : Frames) {
      packets.push_back(PacketIn(frame));
    }
    return packets;
  }

 private:
  static Bytes PacketIn(const Bytes& frame) { return {frame.begin() + 14, frame.end() - 1}; }

  void Take(std::uint8_t byte) {
    partial_.push_back(byte);
    if (partial_.size() >= 3 && partial_.size() == partial_[1] * 256U + partial_[2] + 4U) {
      Frames.push_back(partial_);
      partial_.clear();
      if (Frames.back()[3] == 0) {
        OnPacket(PacketIn(Frames.back()));
      }
    }
  }

  Bytes partial_;
};

/// Records what a job shows: "Status Idle", "Found 3", "Clear", "Refresh".
class FakeRadioDisplay : public RadioDisplay {
 public:
  std::vector<std::string> Log;
  std::vector<std::string> Progress;  ///< "Pass 1 of 2, ID 32: 0/256"
  std::function<void()> OnRefresh = [] {};

  void SetStatus(const std::string& text) override { Log.push_back("Status " + text); }
  void SetPlayersFound(int count) override { Log.push_back("Found " + std::to_string(count)); }
  void ClearGunList() override { Log.emplace_back("Clear"); }
  void RefreshGunList() override {
    Log.emplace_back("Refresh");
    OnRefresh();
  }
  void SetProgress(const std::string& text, int step, int steps) override {
    std::string entry = text;
    entry.append(": ").append(std::to_string(step)).append("/").append(std::to_string(steps));
    Progress.push_back(entry);
  }
};
