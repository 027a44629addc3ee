#pragma once

#include <cstddef>
#include <memory>
#include <string>
#include <utility>
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

  void End(int exitCode = Killed) {
    Running = false;
    OnEnd(exitCode);
  }
};

/// Programs that a test plays, in the order in which they are asked for. Each may go while the test goes on.
class FakePipedPrograms {
 public:
  std::unique_ptr<PipedProgram> Make() {
    auto made = std::make_unique<Owned>();
    made->Owner = this;
    live_.push_back(made.get());
    ++Made;
    return made;
  }

  /// How many there have been.
  int Made = 0;

  /// How many there are now.
  std::size_t Live() const { return live_.size(); }

  /// One of those that there are now, counted from 0.
  FakePipedProgram& At(std::size_t index) { return *live_.at(index); }

 private:
  struct Owned : FakePipedProgram {
    FakePipedPrograms* Owner = nullptr;
    ~Owned() override { std::erase(Owner->live_, this); }
    Owned() = default;
    Owned(const Owned&) = delete;
    Owned& operator=(const Owned&) = delete;
  };

  std::vector<FakePipedProgram*> live_;
};
