#pragma once

#include <gmock/gmock.h>

#include <cstdint>
#include <deque>
#include <utility>
#include <vector>

#include "tests/fakes/FakeSerialPort.h"

/// The far end of a line that expects certain bytes and answers them with certain others.
class ScriptedAdapter {
 public:
  using Bytes = std::vector<std::uint8_t>;

  explicit ScriptedAdapter(FakeSerialPort& port) : port_(port) {
    port_.OnOutput = [this](std::uint8_t byte) { Take(byte); };
  }

  /// After what was expected before comes `sent`, and `answer` as soon as it is there.
  void Expect(const Bytes& sent, const Bytes& answer) {
    exchanges_.emplace_back(sent, answer);
    all_.insert(all_.end(), sent.begin(), sent.end());
  }

  /// The line was sent all that was expected, and nothing else.
  void Verify() const { EXPECT_EQ(port_.Sent, all_); }

 private:
  void Take(std::uint8_t byte) {
    pending_.push_back(byte);
    if (!exchanges_.empty() && pending_ == exchanges_.front().first) {
      port_.Receive(exchanges_.front().second);
      exchanges_.pop_front();
      pending_.clear();
    }
  }

  FakeSerialPort& port_;
  std::deque<std::pair<Bytes, Bytes>> exchanges_;
  Bytes all_;
  Bytes pending_;
};
