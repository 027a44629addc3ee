#include "ui/Look.h"

#include <QApplication>
#include <QIcon>
#include <QLibraryInfo>
#include <QPalette>

#include "ui/WorkArea.h"

namespace {

constexpr const char* StyleSheet = R"(
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
#GameBar QToolButton { padding: 3px 8px; border: 1px solid transparent; border-radius: 4px; }
#GameBar QToolButton:hover, #GameBar QToolButton:focus { border-color: palette(mid); background: palette(button); }
#GameLine { border: 0; border-top: 1px solid palette(mid); }
#GameLine QToolButton { border: 1px solid transparent; }
#GameLine QToolButton:focus { border-color: palette(window-text); }
#Boards > #Label1, #Boards > #Label2 { font-weight: bold; }
ScoreListView, MemberListView, #DataList, #SoundList { border: 1px solid palette(mid); selection-background-color: #2f6fd6; selection-color: white; }
ScoreListView QHeaderView::section, #DataList QHeaderView::section, #SoundList QHeaderView::section { padding: 5px 8px; border: 0; border-bottom: 2px solid palette(mid);
  background: palette(button); color: palette(button-text); }
#DataList QHeaderView::section { padding: 5px 3px; font-weight: bold; }
#SoundList QHeaderView::section { padding: 5px 3px; }
)";

/// Some desktops with a dark palette leave placeholders black and links dark blue.
void MakePlaceholdersAndLinksReadable() {
  const QPalette desktop = QApplication::palette();
  constexpr int faint = 176;  // of 255; less, and they can hardly be read
  QColor placeholder = desktop.color(QPalette::Text);
  placeholder.setAlpha(faint);
  QPalette own;
  own.setColor(QPalette::PlaceholderText, placeholder);
  constexpr int halfLight = 128;
  if (desktop.color(QPalette::Base).lightness() < halfLight &&
      desktop.color(QPalette::Link).lightness() <= halfLight) {
    own.setColor(QPalette::Link, QColor(0x7f, 0xb4, 0xff));
  }
  QApplication::setPalette(own);
}

}  // namespace

void PrepareLook() {
  Q_INIT_RESOURCE(pictures);  // a static library's resources are not registered by themselves
  QApplication::setDesktopFileName(QStringLiteral("tessarine"));
  QApplication::setWindowIcon(QIcon(QStringLiteral(":/pictures/tessarine-256.png")));
  MakePlaceholdersAndLinksReadable();
  qApp->setStyleSheet(QString::fromUtf8(StyleSheet));
  qApp->installEventFilter(new WorkArea(qApp));
}

void UseDialogTexts(QTranslator& texts, Language language) {
  if (language == Language::SimplifiedChinese &&
      texts.load(QStringLiteral("qtbase_zh_CN"), QLibraryInfo::path(QLibraryInfo::TranslationsPath))) {
    QCoreApplication::installTranslator(&texts);
  }
}
