#pragma once

#include <chrono>
#include <cstdint>
#include <functional>
#include <string>
#include <vector>

#include "tests/fakes/FakeEventPump.h"
#include "tests/fakes/FakeSerialPort.h"

/// Sound hardware at the far end of a line: takes commands and data, and acknowledges each.
class FakeRecorder {
 public:
  FakeRecorder(FakeSerialPort& port, FakeEventPump& pump) : port_(port), pump_(pump) {
    port.OnOutput = [this](std::uint8_t byte) { Take(byte); };
  }

  bool StandAlone = true;

  /// What came: "start", "erase", "header 3", "pages 78", "data" (with its check byte), "end", "play 3".
  std::vector<std::string> Log;

  /// Called with each entry of the log and how often it came already; false: it is not acknowledged.
  std::function<bool(const std::string&)> Acknowledges = [](const std::string&) { return true; };

  /// What it answers instead.
  std::vector<std::uint8_t> Answer = {0xAA};
  std::chrono::milliseconds AnswerTime{5};
  std::chrono::milliseconds EraseTime{2000};
  bool Erases = true;  ///< else the erase is acknowledged but does not end

  /// The data blocks, without check bytes.
  std::vector<std::vector<std::uint8_t>> Data;
  std::vector<std::uint8_t> CheckBytes;

  /// As after its power was off for a moment.
  void Forget() {
    Log.clear();
    Data.clear();
    CheckBytes.clear();
    bytes_.clear();
    dataLeft_ = 0;
    pageCountComes_ = false;
    started_ = false;
  }

 private:
  void Take(std::uint8_t byte) {
    bytes_.push_back(byte);
    if (dataLeft_ > 0) {
      TakeData();
    } else if (pageCountComes_) {
      TakePageCount();
    } else {
      TakeCommand();
    }
  }

  void TakeData() {
    if (bytes_.size() < 257) {
      return;
    }
    Data.emplace_back(bytes_.begin(), bytes_.end() - 1);
    CheckBytes.push_back(bytes_.back());
    --dataLeft_;
    Done("data");
  }

  void TakePageCount() {
    if (bytes_.size() == 2) {
      pageCountComes_ = false;
      dataLeft_ = bytes_[0] + 256 * bytes_[1];
      Log.push_back("pages " + std::to_string(dataLeft_));
      bytes_.clear();
    }
  }

  void TakeCommand() {
    const std::uint8_t first = bytes_[0];
    const std::size_t length = first == (StandAlone ? 3 : 14) ? 3 : !StandAlone && first == 1 ? 4 : 2;
    if (bytes_.size() < length) {
      return;
    }
    if (length == 3) {
      Done("play " + std::to_string(bytes_[2]));
    } else if (length == 4) {
      dataLeft_ = 1;
      bytes_.clear();
    } else if (first == 0) {
      started_ = false;
      Done("end");
    } else if (first == 1) {
      pageCountComes_ = true;
      Done("header " + std::to_string(bytes_[1]));
    } else if (first == 2 && (started_ || !StandAlone)) {
      Done("erase");
      if (Erases) {
        pump_.At(EraseTime, [this] { port_.Receive({0xAA}); });
      }
    } else {
      started_ = true;
      Done("start");
    }
  }

  void Done(const std::string& what) {
    bytes_.clear();
    Log.push_back(what);
    if (Acknowledges(what)) {
      pump_.At(AnswerTime, [this] { port_.Receive(Answer); });
    }
  }

  FakeSerialPort& port_;
  FakeEventPump& pump_;
  std::vector<std::uint8_t> bytes_;
  int dataLeft_ = 0;
  bool pageCountComes_ = false;
  bool started_ = false;
};
