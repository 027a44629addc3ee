#include "app/Composition.h"

#include <QApplication>
#include <QDir>
#include <QLibraryInfo>
#include <QLocale>

#include "app/frmRx.h"
#include "core/data/FirstRun.h"
#include "devices/buttons/ButtonSwipe.h"
#include "platform/ErrorReport.h"
#include "ui/Look.h"

namespace {

Language LanguageOfSystem() {
  const QStringList languages = QLocale::system().uiLanguages();
  return LanguageOf(languages.isEmpty() ? std::string() : languages.first().toStdString());
}

/// Where the word processor's module lies: beside the program, or where it is installed.
std::string ModuleFolder() {
  const QDir program(QCoreApplication::applicationDirPath());
  const bool isBuildTree = program.exists(QStringLiteral("tessarine-office-host"));
  return (isBuildTree ? program.absolutePath()
                      : QDir::cleanPath(program.absoluteFilePath(QStringLiteral(TESSARINE_MODULE_PATH))))
      .toStdString();
}

std::string SettingsFile(const Folders& folders) {
  std::string folder;
  folders.LocalAppData(folder);
  return folder + UserDataSubfolder + "/tessarine.ini";
}

}  // namespace

Composition::Composition()
    : strings_(LanguageOfSystem()),
      readerSettings_(files_, SettingsFile(folders_)),
      wordProcessor_(ModuleFolder()) {
  if (strings_.TextLanguage() == Language::SimplifiedChinese &&
      dialogTexts_.load(QStringLiteral("qtbase_zh_CN"), QLibraryInfo::path(QLibraryInfo::TranslationsPath))) {
    QCoreApplication::installTranslator(&dialogTexts_);
  }
}

::Services Composition::Services() {
  return {strings_,
          clock_,
          databases_,
          old_,
          events_,
          fileDialog_,
          files_,
          folders_,
          boxes_,
          devices_,
          port_,
          wordProcessor_,
          [this] { return SwipeButton(); }};
}

std::string Composition::SwipeButton() {
  ButtonSwipe window(wire_, boxes_, strings_, parent_.Window());
  window.exec();
  return window.DallasID();
}

int RunProgram() {
  PrepareLook();
  Composition composition;
  frmRx window(composition.Services());
  composition.SetMainWindow(&window);
  bool loaded = false;
  if (!ReportErrors(composition.Boxes(), [&] { loaded = window.FormLoad(); }) || !loaded) {
    return 1;
  }
  window.show();
  return QApplication::exec();
}
