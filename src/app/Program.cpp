#include "app/Program.h"

#include <QApplication>

#include "app/SystemFacts.h"
#include "platform/ErrorReport.h"
#include "ui/CommandEvent.h"
#include "ui/Look.h"

Program::Program() {
  PrepareLook();
  qApp->installEventFilter(&altLetters_);  // behind the look's own, so before it: captions may grow
  composition_.Log().Started(SystemFacts());
  qApp->installEventFilter(this);
  window_.emplace(composition_.Services());
  composition_.SetMainWindow(&*window_);
  composition_.OnFailure = [this] { window_->PointToSystemCheck(); };
}

bool Program::Start() {
  bool loaded = false;
  if (!ReportErrors(composition_.Boxes(), [&] { loaded = window_->FormLoad(); }) || !loaded) {
    return false;
  }
  window_->show();
  started_ = true;
  return true;
}

void Program::Listen(int listener) {
  // Behind the main window there is nothing more to bring to the front: the caller waits for this program's
  // end.
  const auto mayTake = [this] { return !started_ || window_->isVisible(); };
  calls_.emplace(listener, mayTake, [this](const InstanceRequest& request) {
    window_->ComeToFront(request.Token);
    if (!request.Path.empty()) {
      window_->Open(request.Path);
    }
  });
}

int Program::Run() {
  const int exitCode = Start() ? QApplication::exec() : 1;
  composition_.Log().Ended(exitCode);
  return exitCode;
}

bool Program::eventFilter(QObject* watched, QEvent* event) {
  if (event->type() == CommandEvent::EventType()) {
    composition_.Log().Command(static_cast<CommandEvent*>(event)->Name().toStdString());
  }
  return QObject::eventFilter(watched, event);
}
