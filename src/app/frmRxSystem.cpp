// The main window among the other programs of the computer: files that other starts bring, new versions,
// System Check.

#include <QApplication>
#include <optional>

#include "app/StateKeys.h"
#include "app/SystemFacts.h"
#include "app/frmRx.h"
#include "check/SystemCheck.h"
#include "ui/CommandEvent.h"
#include "ui/Text.h"
#include "ui_frmRx.h"

namespace {

QString NameOfFile(const std::string& path) {
  return QString::fromStdString(path.substr(path.find_last_of('/') + 1));
}

}  // namespace

void frmRx::Open(const std::string& path) {
  constexpr int untilNextTry = 50;  // milliseconds
  if (desk_) {
    const bool isLeftOut = !waitingFile_.empty() && waitingFile_ != path;
    desk_->Tell({QStringLiteral("FileLeftOut"),
                 isLeftOut ? Text(services_.Strings, OwnText::DeskFileLeftOut).arg(NameOfFile(waitingFile_))
                           : QString()});
  }
  waitingFile_ = path;
  waitingFileTimer_.start(untilNextTry);
  // The caller is not kept waiting.
  QTimer::singleShot(0, this, &frmRx::OpenWaitingFile);
}

void frmRx::OpenWaitingFile() {
  if (waitingFile_.empty() || !isVisible()) {
    return;
  }
  const QString entry = QStringLiteral("FileWaits");
  if (IsBusy()) {
    desk_->Tell({entry, Text(services_.Strings, OwnText::DeskFileWaits).arg(NameOfFile(waitingFile_))});
    return;
  }
  waitingFileTimer_.stop();
  desk_->Tell({entry, QString()});
  const std::string path = std::exchange(waitingFile_, {});
  CommandEvent event(QStringLiteral("OpenFile"));
  QCoreApplication::sendEvent(QCoreApplication::instance(), &event);
  commands_.Run([&] { LoadFromOutside(path, desk_->Progress().Unsaved() && !keeping_->IsKept()); });
  desk_->Show();
  desk_->FocusBoard();
}

void frmRx::ComeToFront(const std::string& token) {
  constexpr int untilAttention = 500;  // milliseconds
  if (!isVisible()) {
    return;
  }
  setWindowState(windowState() & ~Qt::WindowMinimized);
  QWidget* const modal = QApplication::activeModalWidget();
  QWidget& front = modal != nullptr ? *modal : *this;
  qputenv("XDG_ACTIVATION_TOKEN", QByteArray::fromStdString(token));  // where the toolkit looks for it
  front.raise();
  front.activateWindow();
  qunsetenv("XDG_ACTIVATION_TOKEN");
  QTimer::singleShot(untilAttention, this, [this] {
    if (QApplication::activeWindow() == nullptr) {
      QApplication::alert(this);
    }
  });
}

void frmRx::TellNewVersion() {
  if (services_.Release.empty()) {
    return;
  }
  const bool hasRunBefore = services_.Disk.FileExists(userDataFolder_ + State::File);
  const std::string before = state_->ReadIni(State::Program, State::Release, {});
  if (before == services_.Release) {
    return;
  }
  state_->WriteIni(State::Program, State::Release, services_.Release);
  if (hasRunBefore) {
    const QString page = Text(services_.Strings, OwnText::WhatIsNew);
    desk_->Tell(
        {QStringLiteral("NewVersion"),
         Text(services_.Strings, OwnText::DeskNewVersion).arg(QString::fromStdString(services_.Release))});
    desk_->Tell({QStringLiteral("WhatIsNew"), page, [this, page] { manual_.OpenPage(page); }, {}, true});
  }
}

WordFinding frmRx::FindingOfWordProcessor() {
  if (!ui_->mnuPrintScores->isEnabled()) {
    return WordFinding::Missing;
  }
  // Until its first start has succeeded or failed, it is followed.
  const WordState state =
      wordProcessorTimer_.isActive() ? WordState::Starting : services_.WordProcessor.State();
  switch (state) {
    case WordState::Starting:
      return WordFinding::Untried;
    case WordState::Ready:
      return WordFinding::Ready;
    case WordState::Ended:
      break;
  }
  return WordFinding::Ended;
}

void frmRx::ShowSystemCheck() {
  desk_->Tell({QStringLiteral("SystemCheck"), QString()});  // what pointed here has done its part
  const auto readerPort = [this]() -> std::optional<std::int16_t> {
    std::int16_t port = 0;
    std::int16_t type = 0;
    const bool isSet = services_.Wire != nullptr && services_.Wire->TMReadDefaultPort(port, type) > 0;
    return isSet ? std::optional(port) : std::nullopt;
  };
  const auto pathInUse = [this](CheckSubject subject) {
    return (subject == CheckSubject::Members ? session_.DbMembers() : session_.DbScenarios()).Path();
  };
  const SystemChecks checks(
      {.Strings = services_.Strings,
       .Time = services_.Time,
       .Computer = *services_.Computer,
       .Devices = services_.Devices,
       .Ini = *ini_,
       .Disk = services_.Disk,
       .Databases = services_.Archives != nullptr ? *services_.Archives : services_.Databases,
       .UserDataFolder = userDataFolder_,
       .WordProcessor = [this] { return FindingOfWordProcessor(); },
       .ChineseLetters = ChineseLetters,
       .Screens = ScreenTexts,
       .ReaderPort = readerPort,
       .PathInUse = pathInUse,
       .Release = services_.Release});
  SystemCheck({.Checks = checks,
               .Strings = services_.Strings,
               .Boxes = services_.Boxes,
               .Events = services_.Events,
               .Facts = SystemFacts()},
              this)
      .exec();
}

void frmRx::PointToSystemCheck() {
  hasFailed_ = true;
  if (desk_ && services_.Computer != nullptr) {
    desk_->Tell({QStringLiteral("SystemCheck"), Text(services_.Strings, OwnText::SystemCheckTitle),
                 [this] { ui_->mnuSystemCheck->trigger(); }});
  }
}
