#include "web/PageProbe.h"

#include <utility>

PageProbe::PageProbe(PipedProgram& program, std::string path) : program_(program), path_(std::move(path)) {
  program_.OnOutput = [this](std::string_view bytes) { TakeReports(bytes); };
  program_.OnEnd = [this](int /*exitCode*/) {
    if (std::exchange(asking_, false)) {
      Become(false);
    }
  };
}

PageProbe::~PageProbe() {
  program_.Stop();
  program_.OnOutput = nullptr;
  program_.OnEnd = nullptr;
}

void PageProbe::Ask(const std::string& address, std::uint16_t port) {
  const bool isLate = std::exchange(asking_, true);
  reports_ = {};
  program_.Start({path_, "--ask", address, std::to_string(port)}, std::chrono::milliseconds(0));
  if (isLate) {
    Become(false);
  }
}

void PageProbe::Forget() {
  asking_ = false;
  program_.Stop();
  Become(false);
}

void PageProbe::TakeReports(std::string_view bytes) {
  reports_.Add(bytes);
  const auto report = reports_.Next();
  if (asking_ && report) {
    asking_ = false;
    Become(report->Kind == ReportKind::Answer && report->Number == 1);
  }
}

void PageProbe::Become(bool answered) {
  if (std::exchange(answered_, answered) != answered && OnChange) {
    OnChange();
  }
}
