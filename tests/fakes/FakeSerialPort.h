#pragma once

#include <algorithm>
#include <chrono>
#include <deque>
#include <functional>
#include <string>
#include <vector>

#include "platform/RuntimeError.h"
#include "platform/SerialPort.h"
#include "tests/fakes/FakeEventPump.h"

/// A serial line whose far end is the test.
class FakeSerialPort : public SerialPort {
 public:
  /// All operations that change something, in order: "Open /dev/x 19200,N,8,1", "Output 170", "ClearInput",
  /// "Settings 9600,N,8,1", "Close"; a failed one ends with " failed 8002".
  std::vector<std::string> Log;

  /// All bytes put on the line.
  std::vector<std::uint8_t> Sent;

  /// From the last successful open; `Settings` also from later changes.
  std::string Device;
  std::string Settings;

  /// A drain of the open line, including those of a close and of a change of settings.
  struct DrainCall {
    std::size_t BytesSent;           ///< before the drain
    std::chrono::microseconds Time;  ///< when it ended; 0 without a `Pump`

    bool operator==(const DrainCall&) const = default;
  };
  std::vector<DrainCall> Drains;

  /// As last set by SetInstrument.
  std::string Instrument;

  /// If set, the line has the baud rate of its settings: each byte takes its time, which passes in a drain.
  FakeEventPump* Pump = nullptr;

  /// Called with each byte put on the line, so that a test can answer.
  std::function<void(std::uint8_t)> OnOutput;

  /// Lets bytes arrive. As on a real line, those that came before the open are lost.
  void Receive(const std::vector<std::uint8_t>& bytes) {
    input_.insert(input_.end(), bytes.begin(), bytes.end());
  }

  /// The next open fails with this number.
  void FailNextOpen(int number) { openFailure_ = number; }

  /// The next change of settings fails with this number.
  void FailNextSettings(int number) { settingsFailure_ = number; }

  /// Every output fails with this number, until 0 is given.
  void FailOutput(int number) { outputFailure_ = number; }

  /// The line is unplugged; bytes that came before stay readable. The object stays open until Close().
  void Lose() { lost_ = true; }

  void Open(const std::string& device, const std::string& settings) override {
    const std::string entry = "Open " + device + ' ' + settings;
    const int failure = open_ ? Fault::PortAlreadyOpen : openFailure_;
    openFailure_ = 0;
    FailIf(failure, entry);
    Log.push_back(entry);
    Device = device;
    Settings = settings;
    open_ = true;
    lost_ = false;
    input_.clear();
  }

  void Close() override {
    if (open_) {
      LetPass();
      Log.push_back("Close");
    }
    open_ = false;
    input_.clear();
  }

  bool PortOpen() const override { return open_; }

  void SetSettings(const std::string& settings) override {
    const int failure = !open_ ? Fault::PortNotOpen : lost_ ? Fault::PortLost : settingsFailure_;
    settingsFailure_ = 0;
    FailIf(failure, "Settings " + settings);
    LetPass();
    Log.push_back("Settings " + settings);
    Settings = settings;
  }

  std::size_t InBufferCount() override {
    if (!open_) {
      throw RuntimeError(Fault::PortNotOpen);
    }
    if (lost_ && input_.empty()) {
      throw RuntimeError(Fault::PortLost);
    }
    return input_.size();
  }

  std::uint8_t Input() override {
    if (InBufferCount() == 0) {
      throw RuntimeError(Fault::PastEndOfFile);
    }
    const std::uint8_t byte = input_.front();
    input_.pop_front();
    return byte;
  }

  void Output(std::uint8_t byte) override {
    const std::string entry = "Output " + std::to_string(byte);
    FailIf(!open_ ? Fault::PortNotOpen : lost_ ? Fault::PortLost : outputFailure_, entry);
    Log.push_back(entry);
    Sent.push_back(byte);
    if (Pump != nullptr) {
      constexpr std::chrono::microseconds bitsOfAByte{10'000'000};
      idleAt_ = std::max(idleAt_, Pump->Elapsed()) + bitsOfAByte / std::stoi(Settings);
    }
    if (const auto onOutput = OnOutput) {
      onOutput(byte);
    }
  }

  void Drain() override {
    FailIf(!open_ ? Fault::PortNotOpen : lost_ ? Fault::PortLost : 0, "Drain");
    LetPass();
  }

  void ClearInput() override {
    FailIf(open_ ? 0 : Fault::PortNotOpen, "ClearInput");
    Log.push_back("ClearInput");
    input_.clear();
  }

  void SetInstrument(const std::string& name) override { Instrument = name; }

 private:
  void LetPass() {
    if (Pump != nullptr && idleAt_ > Pump->Elapsed()) {
      Pump->Pass(idleAt_ - Pump->Elapsed());
    }
    Drains.push_back({Sent.size(), Pump != nullptr ? Pump->Elapsed() : std::chrono::microseconds(0)});
  }

  void FailIf(int number, const std::string& entry) {
    if (number != 0) {
      Log.push_back(entry + " failed " + std::to_string(number));
      throw RuntimeError(number);
    }
  }

  bool open_ = false;
  bool lost_ = false;
  int openFailure_ = 0;
  int settingsFailure_ = 0;
  int outputFailure_ = 0;
  std::chrono::microseconds idleAt_{0};
  std::deque<std::uint8_t> input_;
};
