#include "web/PageServer.h"

#include <algorithm>
#include <utility>

using namespace std::chrono_literals;

namespace {

constexpr std::chrono::milliseconds FirstPause = 1s;
constexpr std::chrono::milliseconds LongestPause = 60s;

/// A program that served as long as this may be started again as soon as one that never failed.
constexpr std::chrono::seconds LongEnough = 60s;

/// More means that the program no longer reads.
constexpr std::size_t MostUnread = 2 * MostPageBytes;

/// A program that works reports once a second.
constexpr int MostReportsASecond = 20;

}  // namespace

PageServer::PageServer(PipedProgram& program, const MonotonicClock& clock, ResultsPages& pages,
                       std::string path)
    : program_(program), clock_(clock), pages_(pages), path_(std::move(path)) {
  program_.OnOutput = [this](std::string_view bytes) { TakeReports(bytes); };
  program_.OnEnd = [this](int exitCode) { StartAgain(exitCode); };
}

PageServer::~PageServer() {
  program_.Stop();
  program_.OnOutput = nullptr;
  program_.OnEnd = nullptr;
}

void PageServer::SwitchOn(const std::string& address, std::uint16_t port) {
  address_ = address;
  port_ = port;
  pause_ = 0ms;
  state_.Starts = 0;
  Start(0ms, 0);
}

void PageServer::SwitchOff() {
  program_.Stop();
  Become({});
}

void PageServer::Update() {
  if (state_.Now != PageServing::Phase::Serving) {
    return;  // it gets all pages once it answers
  }
  TellVisitors();
  for (const PageFrame& frame : pages_.TakeChanges()) {
    program_.Write(EncodeFrame(frame));
  }
  if (program_.Unread() > MostUnread) {
    StartAgain();
  }
}

void PageServer::Replace() {
  if (state_.Now == PageServing::Phase::Serving) {
    StartAgain();
  }
}

void PageServer::Start(std::chrono::milliseconds pause, int lastEnd) {
  reports_ = {};
  visitors_ = 0;
  toldVisitors_ = clock_.Elapsed() - 1s;
  const PageServing::Phase phase = pause > 0ms ? PageServing::Phase::Pausing : PageServing::Phase::Starting;
  program_.Start({path_, address_, std::to_string(port_)}, pause);
  Become({.Now = phase, .Port = 0, .Visitors = 0, .Starts = state_.Starts + 1, .LastEnd = lastEnd});
}

void PageServer::TakeReports(std::string_view bytes) {
  reports_.Add(bytes);
  while (const auto report = reports_.Next()) {
    if (IsTooTalkative() || !Take(*report)) {
      StartAgain();
      return;
    }
  }
  if (reports_.Broken()) {
    StartAgain();
  }
}

bool PageServer::IsTooTalkative() {
  const std::chrono::microseconds now = clock_.Elapsed();
  if (now - secondSince_ >= 1s) {
    secondSince_ = now;
    reportsOfSecond_ = 0;
  }
  return ++reportsOfSecond_ > MostReportsASecond;
}

bool PageServer::Take(const PageReport& report) {
  switch (report.Kind) {
    case ReportKind::Port:
      return TakePort(report.Number);
    case ReportKind::Visitors:
      TakeVisitors(report.Number);
      return true;
    case ReportKind::Answer:
      break;
  }
  return false;
}

bool PageServer::TakePort(std::uint32_t port) {
  if (state_.Now == PageServing::Phase::Serving) {
    return false;
  }
  servingSince_ = clock_.Elapsed();
  for (const PageFrame& frame : pages_.TakeAll()) {
    program_.Write(EncodeFrame(frame));
  }
  Become({.Now = PageServing::Phase::Serving,
          .Port = static_cast<std::uint16_t>(port),
          .Visitors = 0,
          .Starts = state_.Starts});
  return true;
}

void PageServer::TakeVisitors(std::uint32_t visitors) {
  visitors_ = visitors;
  if (clock_.Elapsed() - toldVisitors_ >= 1s) {
    TellVisitors();
  }
}

void PageServer::TellVisitors() {
  toldVisitors_ = clock_.Elapsed();
  PageServing state = state_;
  state.Visitors = visitors_;
  Become(state);
}

void PageServer::StartAgain(int lastEnd) {
  const bool served = state_.Now == PageServing::Phase::Serving;
  if (served && clock_.Elapsed() - servingSince_ >= LongEnough) {
    pause_ = 0ms;
  }
  pause_ = pause_ == 0ms ? FirstPause : std::min(2 * pause_, LongestPause);
  Start(pause_, lastEnd);
}

void PageServer::Become(const PageServing& state) {
  const bool changed = state != state_;
  state_ = state;
  if (changed && OnChange) {
    OnChange();
  }
}
