#include "app/Composition.h"

#include <QApplication>
#include <QDir>

#include "app/Release.h"
#include "app/SystemFacts.h"
#include "core/data/FirstRun.h"
#include "devices/buttons/ButtonSwipe.h"
#include "platform/qt/QtPipedProgram.h"
#include "platform/qt/UprightPicture.h"
#include "ui/Look.h"

namespace {

/// Folder of the word processor's module and of the programs that this one starts: beside the program, or
/// where it is installed.
std::string ModuleFolder() {
  const QDir program(QCoreApplication::applicationDirPath());
  const bool isBuildTree = program.exists(QStringLiteral("tessarine-office-host"));
  return (isBuildTree ? program.absolutePath()
                      : QDir::cleanPath(program.absoluteFilePath(QStringLiteral(TESSARINE_MODULE_PATH))))
      .toStdString();
}

std::string UserDataFolder(const Folders& folders) {
  std::string folder;
  folders.LocalAppData(folder);
  return folder + UserDataSubfolder;
}

}  // namespace

Composition::Composition()
    : strings_(LanguageOfSystem()),
      log_(files_, clock_, UserDataFolder(folders_)),
      logFolder_(UserDataFolder(folders_) + "/logs"),
      readerSettings_(files_, UserDataFolder(folders_) + "/tessarine.ini"),
      wordProcessor_(ModuleFolder()),
      resultsProgram_(ModuleFolder() + "/tessarine-results") {
  UseDialogTexts(dialogTexts_, strings_.TextLanguage());
}

::Services Composition::Services() {
  return {.Strings = strings_,
          .Time = clock_,
          .Databases = databases_,
          .Old = old_,
          .Events = events_,
          .Elapsed = events_,
          .CommonDialog1 = fileDialog_,
          .Disk = files_,
          .Places = folders_,
          .Boxes = failureBoxes_,
          .OtherPrograms = otherPrograms_,
          .Devices = devices_,
          .MSComm1 = loggedPort_,
          .WordProcessor = wordProcessor_,
          .UprightPicture = UprightPicture,
          .Awake = awake_,
          .SoundPort = loggedSoundPort_,
          .SoundPlayer = soundPlayer_,
          .SoundConverter = soundConverter_,
          .Addresses = addresses_,
          .MakePipedProgram = [this] { return std::make_unique<QtPipedProgram>(&resultsProgram_); },
          .ResultsProgram = resultsProgram_.Name(),
          .ButtonSwipe = [this] { return SwipeButton(); },
          .Wire = &wire_,
          .Archives = &archives_,
          .Computer = &computer_,
          .Release = ReleaseText()};
}

std::string Composition::SwipeButton() {
  ButtonSwipe window(wire_, failureBoxes_, strings_, parent_.Window());
  window.exec();
  return window.DallasID();
}

std::function<void(const std::string& device, const std::string& settings, int fault)>
Composition::NoteOpening() {
  return [this, note = NoteFault()](const std::string& device, const std::string& settings, int fault) {
    log_.PortOpening(device, settings, fault);
    note(device, settings, fault);
  };
}

std::function<void(const std::string& device, const std::string& settings, int fault)>
Composition::NoteFault() {
  return [this](const std::string& /*device*/, const std::string& /*settings*/, int fault) {
    if (fault != 0) {
      TellFailure();
    }
  };
}

void Composition::TellFailure() const {
  if (OnFailure) {
    OnFailure();
  }
}
