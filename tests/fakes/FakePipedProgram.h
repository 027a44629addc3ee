#pragma once

#include <string>
#include <vector>

#include "platform/PipedProgram.h"

/// A program that a test plays.
class FakePipedProgram : public PipedProgram {
 public:
  struct Run {
    std::vector<std::string> Words;
    std::chrono::milliseconds Pause{};
  };

  /// All starts so far.
  std::vector<Run> Runs;

  /// What the last one was sent.
  std::string Input;

  bool Running = false;

  /// What Unread answers.
  std::size_t Backlog = 0;

  void Start(const std::vector<std::string>& words, std::chrono::milliseconds pause) override {
    Runs.push_back({words, pause});
    Input.clear();
    Running = true;
  }
  void Write(std::string_view bytes) override { Input += bytes; }
  std::size_t Unread() const override { return Backlog; }
  void Stop() override { Running = false; }

  void End() {
    Running = false;
    OnEnd();
  }
};
