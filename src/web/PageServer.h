#pragma once

#include <chrono>
#include <cstdint>
#include <functional>
#include <string>

#include "platform/MonotonicClock.h"
#include "platform/PipedProgram.h"
#include "web/PageStream.h"
#include "web/ResultsPages.h"

/// How the serving of the pages stands.
struct PageServing {
  enum class Phase {
    Off,
    Starting,  ///< no answer yet
    Serving,
    Pausing  ///< the program ended; it is started again after a pause
  };

  Phase Now = Phase::Off;
  std::uint16_t Port = 0;      ///< while Serving: the wanted one, or the next that was free
  std::uint32_t Visitors = 0;  ///< of the last minute
  int Starts = 0;              ///< since it was switched on
  int LastEnd = 0;             ///< while Pausing: the program's exit code, see ServerEnd and PipedProgram

  bool operator==(const PageServing&) const = default;
};

/// Keeps the program running that serves the pages, and its pages those of now.
class PageServer {
 public:
  /// `path` is that of the program. All must outlive this.
  PageServer(PipedProgram& program, const MonotonicClock& clock, ResultsPages& pages, std::string path);
  ~PageServer();
  PageServer(const PageServer&) = delete;
  PageServer& operator=(const PageServer&) = delete;

  /// Called after each change of State.
  std::function<void()> OnChange;

  /// Serves at an address of this computer, in digits, and the port or the next free one.
  void SwitchOn(const std::string& address, std::uint16_t port);
  void SwitchOff();

  /// Sends what has changed in the pages, and tells the visitors that came too soon after others. To be
  /// called every few seconds too.
  void Update();

  /// Ends a program that nobody gets an answer from, and starts it again after a pause.
  void Replace();

  const PageServing& State() const { return state_; }

 private:
  void Start(std::chrono::milliseconds pause, int lastEnd);
  void TakeReports(std::string_view bytes);
  /// False if the program says what it must not say now.
  bool Take(const PageReport& report);
  bool TakePort(std::uint32_t port);
  void TakeVisitors(std::uint32_t visitors);
  void TellVisitors();
  bool IsTooTalkative();
  void StartAgain(int lastEnd = PipedProgram::Killed);
  void Become(const PageServing& state);

  PipedProgram& program_;
  const MonotonicClock& clock_;
  ResultsPages& pages_;
  std::string path_;
  std::string address_;
  std::uint16_t port_ = 0;
  PageServing state_;
  PageReportReader reports_;
  std::chrono::microseconds servingSince_{};
  std::uint32_t visitors_ = 0;  ///< as reported last
  std::chrono::microseconds toldVisitors_{};
  int reportsOfSecond_ = 0;
  std::chrono::microseconds secondSince_{};
  std::chrono::milliseconds pause_{};
};
