#include "app/Composition.h"

#include <QApplication>
#include <QDir>
#include <QIcon>
#include <QLibraryInfo>
#include <QLocale>

#include "core/data/FirstRun.h"
#include "devices/buttons/ButtonSwipe.h"
#include "platform/qt/DialogParent.h"

namespace {

constexpr const char* LookSheet = R"(
#Banner { background: #1b2233; }
#Banner QLabel { color: #e8ecf4; font-weight: bold; }
#Banner QComboBox { min-height: 30px; }
#GetScores, #RemoteManageButton { min-height: 30px; padding: 2px 18px; border-radius: 5px; border: 1px solid #3c4a68;
  background: #2a344c; color: #e8ecf4; font-weight: bold; }
#GetScores { background: #2f6fd6; border-color: #5b92ea; color: white; }
#GetScores:hover { background: #3d7de4; }
#GetScores:pressed { background: #245bb4; }
#GetScores:focus, #RemoteManageButton:focus { border: 2px solid white; }
#RemoteManageButton:disabled { background: #222a3d; border-color: #2c3650; color: #7d879b; }
#centralwidget > #Label1, #centralwidget > #Label2 { font-weight: bold; }
ScoreListView, #DataList { border: 1px solid #c3c9d6; selection-background-color: #2f6fd6; selection-color: white; }
ScoreListView QHeaderView::section, #DataList QHeaderView::section { padding: 5px 8px; border: 0; border-bottom: 2px solid #c3c9d6;
  background: #e9edf4; color: #1b2233; }
#DataList QHeaderView::section { padding: 5px 3px; font-weight: bold; }
)";

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

std::string DataFolder(const Folders& folders) {
  std::string folder;
  folders.LocalAppData(folder);
  return folder + UserDataSubfolder;
}

}  // namespace

Composition::Composition()
    : strings_(LanguageOfSystem()),
      log_(files_, clock_, DataFolder(folders_)),
      readerSettings_(files_, DataFolder(folders_) + "/tessarine.ini"),
      wordProcessor_(ModuleFolder()) {
  if (strings_.TextLanguage() == Language::SimplifiedChinese &&
      dialogTexts_.load(QStringLiteral("qtbase_zh_CN"), QLibraryInfo::path(QLibraryInfo::TranslationsPath))) {
    QCoreApplication::installTranslator(&dialogTexts_);
  }
}

::Services Composition::Services() {
  return {.Strings = strings_,
          .Time = clock_,
          .Databases = databases_,
          .Old = old_,
          .Events = events_,
          .CommonDialog1 = fileDialog_,
          .Disk = files_,
          .Places = folders_,
          .Boxes = boxes_,
          .Devices = devices_,
          .MSComm1 = port_,
          .WordProcessor = wordProcessor_,
          .ButtonSwipe = [this] { return SwipeButton(); }};
}

std::string Composition::SwipeButton() {
  ButtonSwipe window(wire_, boxes_, strings_, DialogParent(mainWindow_));
  window.exec();
  return window.DallasID();
}

void Composition::SetMainWindow(QWidget* window) {
  mainWindow_ = window;
  shownBoxes_.SetMainWindow(window);
  fileDialog_.SetMainWindow(window);
}

void PrepareApplication() {
  Q_INIT_RESOURCE(pictures);  // a static library's resources are not registered by themselves
  QApplication::setDesktopFileName(QStringLiteral("tessarine"));
  QApplication::setWindowIcon(QIcon(QStringLiteral(":/pictures/tessarine-256.png")));
  qApp->setStyleSheet(QString::fromUtf8(LookSheet));
}
