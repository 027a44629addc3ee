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

}  // namespace

PageServer::PageServer(PipedProgram& program, const MonotonicClock& clock, ResultsPages& pages,
                       std::string path)
    : program_(program), clock_(clock), pages_(pages), path_(std::move(path)) {
  program_.OnOutput = [this](std::string_view bytes) { TakeReports(bytes); };
  program_.OnEnd = [this] { StartAgain(); };
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
  Start(0ms);
}

void PageServer::SwitchOff() {
  program_.Stop();
  Become({});
}

void PageServer::Update() {
  if (state_.Now != PageServing::Phase::Serving) {
    return;  // it gets all pages once it answers
  }
  for (const PageFrame& frame : pages_.TakeChanges()) {
    program_.Write(EncodeFrame(frame));
  }
  if (program_.Unread() > MostUnread) {
    StartAgain();
  }
}

void PageServer::Start(std::chrono::milliseconds pause) {
  reports_ = {};
  const PageServing::Phase phase = pause > 0ms ? PageServing::Phase::Pausing : PageServing::Phase::Starting;
  program_.Start({path_, address_, std::to_string(port_)}, pause);
  Become({.Now = phase, .Port = 0, .Visitors = 0, .Starts = state_.Starts + 1});
}

void PageServer::TakeReports(std::string_view bytes) {
  reports_.Add(bytes);
  while (const auto report = reports_.Next()) {
    Take(*report);
  }
  if (reports_.Broken()) {
    StartAgain();
  }
}

void PageServer::Take(const PageReport& report) {
  PageServing state = state_;
  if (report.Kind == ReportKind::Visitors) {
    state.Visitors = report.Number;
    Become(state);
    return;
  }
  if (report.Kind != ReportKind::Port) {
    return;
  }
  state.Port = static_cast<std::uint16_t>(report.Number);
  if (state.Now != PageServing::Phase::Serving) {
    state.Now = PageServing::Phase::Serving;
    servingSince_ = clock_.Elapsed();
    for (const PageFrame& frame : pages_.TakeAll()) {
      program_.Write(EncodeFrame(frame));
    }
  }
  Become(state);
}

void PageServer::StartAgain() {
  const bool served = state_.Now == PageServing::Phase::Serving;
  if (served && clock_.Elapsed() - servingSince_ >= LongEnough) {
    pause_ = 0ms;
  }
  pause_ = pause_ == 0ms ? FirstPause : std::min(2 * pause_, LongestPause);
  Start(pause_);
}

void PageServer::Become(const PageServing& state) {
  const bool changed = state != state_;
  state_ = state;
  if (changed && OnChange) {
    OnChange();
  }
}
