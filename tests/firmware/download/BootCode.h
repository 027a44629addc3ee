#pragma once

#include <algorithm>
#include <chrono>
#include <cstddef>
#include <cstdint>
#include <functional>
#include <optional>
#include <string>
#include <utility>
#include <vector>

#include "tests/fakes/FakeEventPump.h"
#include "tests/fakes/FakeSerialPort.h"

/// What the operator is told of a download that was ended.
inline constexpr const char* AbortText =
    "The device did not finish loading. You are likely to experience unexpected program execution.";

/// The boot code of a device at the far end of a fake line, as far as a test needs it: it answers each
/// command with the good answer, unless the test wants another one.
class BootCode {
 public:
  /// Commands are told apart by their first character.
  using Command = std::string;

  BootCode(FakeSerialPort& port, FakeEventPump& events) : port_(port), events_(events) {
    port_.OnOutput = [this](std::uint8_t byte) { Take(byte); };
  }
  BootCode(const BootCode&) = delete;
  BootCode& operator=(const BootCode&) = delete;

  /// 'p' takes QVM files, 'd' takes QVM2 files.
  char Product = 'd';

  /// Bytes of each buffer that comes by the QVM route, in their order; the last one counts for all others.
  std::vector<std::size_t> BufferSizes = {1};

  /// All commands so far, whole.
  std::vector<Command> Commands;

  /// What the device sends instead of its good answer; nothing lets it answer as it should. Called with each
  /// command once it is whole.
  std::function<std::optional<std::string>(const Command&)> Instead;

  /// Called with each command before it is answered.
  std::function<void(const Command&)> OnCommand;

  std::chrono::milliseconds AnswerTime{5};

  /// Lets the device send something.
  void Say(const std::string& text) { port_.Receive({text.begin(), text.end()}); }
  void SayAt(std::chrono::milliseconds delay, const std::string& text) {
    events_.At(delay, [this, text] { Say(text); });
  }
  void SwitchOnAt(std::chrono::milliseconds delay) {
    events_.At(delay, [this] {
      coming_.clear();
      buffers_ = 0;
      Say("BOOT");
    });
  }

  /// The first characters of all commands.
  std::string Letters() const {
    std::string letters;
    for (const Command& command : Commands) {
      letters += command[0];
    }
    return letters;
  }
  std::size_t CountOf(char letter) const {
    const std::string letters = Letters();
    return static_cast<std::size_t>(std::count(letters.begin(), letters.end(), letter));
  }

 private:
  void Take(std::uint8_t byte) {
    coming_ += static_cast<char>(byte);
    if (coming_.size() < SizeOf(coming_[0])) {
      return;
    }
    const Command command = std::exchange(coming_, {});
    Commands.push_back(command);
    if (OnCommand) {
      OnCommand(command);
    }
    const std::string answer = (Instead ? Instead(command) : std::nullopt).value_or(GoodAnswer(command[0]));
    if (command[0] == 'Z' && answer != "c") {
      ++buffers_;
    }
    if (!answer.empty()) {
      SayAt(AnswerTime, answer);
    }
  }

  std::size_t SizeOf(char letter) const {
    switch (letter) {
      case 'S':
        return 4;
      case 'E':
        return 6;
      case 'Z':
        return Product == 'd' ? 198 : 1 + BufferSizes[std::min(buffers_, BufferSizes.size() - 1)];
      default:
        return 1;
    }
  }

  std::string GoodAnswer(char letter) const {
    switch (letter) {
      case 'X':
        return "x";
      case 'P':
        return {Product};
      case 'B':
        return Product == 'd' ? "s" : "b";
      case 'E':
        return "b";
      default:
        return "f";
    }
  }

  FakeSerialPort& port_;
  FakeEventPump& events_;
  std::string coming_;
  std::size_t buffers_ = 0;
};
