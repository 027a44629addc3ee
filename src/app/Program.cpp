#include "app/Program.h"

#include "platform/ErrorReport.h"

Program::Program() {
  PrepareApplication();
  window_.emplace(composition_.Services());
  composition_.SetMainWindow(&*window_);
}

bool Program::Start() {
  bool loaded = false;
  if (!ReportErrors(composition_.Boxes(), [&] { loaded = window_->FormLoad(); }) || !loaded) {
    return false;
  }
  window_->show();
  return true;
}
