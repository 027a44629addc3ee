#include "demo/DemoRun.h"

#include <QAction>
#include <QApplication>
#include <QFileDialog>
#include <QFileInfo>
#include <QLineEdit>
#include <QMessageBox>
#include <QPushButton>
#include <QRadioButton>
#include <QSaveFile>
#include <QTableView>
#include <QTest>
#include <cstdio>

#include "demo/BoardText.h"
#include "sheets/PrintOptions.h"

namespace {

template <typename Button>
void Press(QWidget& window, const char* name) {
  QTest::mouseClick(window.findChild<Button*>(QString::fromLatin1(name)), Qt::LeftButton);
}

}  // namespace

DemoRun::DemoRun(QMainWindow& window, DemoSource source, const QDir& folder)
    : window_(window),
      source_(source),
      folder_(folder),
      gameFile_(folder.absoluteFilePath(QStringLiteral("game.xml"))) {
  connect(&watch_, &QTimer::timeout, this, &DemoRun::AnswerDialogs);
}

QStringList DemoRun::Run() {
  if (!QTest::qWaitForWindowExposed(&window_)) {
    faults_.append(QStringLiteral("The main window did not appear."));
    return faults_;
  }
  constexpr int watchMilliseconds = 50;
  watch_.start(watchMilliseconds);
  PullGame();
  SaveGame();
  PrintSheets();
  watch_.stop();
  WriteBoard();
  return faults_;
}

// click() returns only when the download has ended, since its handler waits.
void DemoRun::PullGame() {
  if (source_ == DemoSource::BaseUnit) {
    Press<QPushButton>(window_, "GetScores");
    return;
  }
  QTimer::singleShot(0, this, &DemoRun::PullByRadio);
  Press<QPushButton>(window_, "RemoteManageButton");
}

void DemoRun::PullByRadio() {
  QWidget* const radio = QApplication::activeModalWidget();
  if (!QTest::qWaitForWindowExposed(radio)) {
    faults_.append(QStringLiteral("The window of the radio did not appear."));
    return;
  }
  Press<QRadioButton>(*radio, "Guns224");
  Press<QPushButton>(*radio, "SearchGunsButton");
  Press<QPushButton>(*radio, "GetScoresButton");
  if (!radio->grab().save(folder_.absoluteFilePath(QStringLiteral("radio.png")))) {
    faults_.append(QStringLiteral("The picture of the guns could not be written."));
  }
  Press<QPushButton>(*radio, "Close");
}

void DemoRun::SaveGame() {
  window_.findChild<QAction*>(QStringLiteral("mnuSaveScores"))->trigger();
  if (QFileInfo(gameFile_).size() == 0) {
    faults_.append(QStringLiteral("The game was not saved."));
  }
}

void DemoRun::PrintSheets() {
  sheetsPrinted_ = false;
  window_.findChild<QAction*>(QStringLiteral("mnuPrintScores"))->trigger();
  if (!sheetsPrinted_) {
    faults_.append(QStringLiteral("The score sheets were not made."));
  }
}

void DemoRun::WriteBoard() {
  const auto* board = window_.findChild<QTableView*>(QStringLiteral("ScoreDisplay"))->model();
  const auto* teams = window_.findChild<QTableView*>(QStringLiteral("TeamScores"))->model();
  std::printf("%s\n%s", qUtf8Printable(Aligned(*board)), qUtf8Printable(Aligned(*teams)));
  WriteFile(QStringLiteral("board.tsv"), TabSeparated(*board));
  WriteFile(QStringLiteral("teams.tsv"), TabSeparated(*teams));
  if (!window_.grab().save(folder_.absoluteFilePath(QStringLiteral("board.png")))) {
    faults_.append(QStringLiteral("The picture of the board could not be written."));
  }
}

void DemoRun::WriteFile(const QString& name, const QString& text) {
  QSaveFile file(folder_.absoluteFilePath(name));
  if (!file.open(QIODevice::WriteOnly) || file.write(text.toUtf8()) < 0 || !file.commit()) {
    faults_.append(QStringLiteral("%1: %2").arg(name, file.errorString()));
  }
}

void DemoRun::AnswerDialogs() {
  QWidget* front = QApplication::activeModalWidget();
  if (auto* dialog = qobject_cast<QFileDialog*>(front)) {
    dialog->findChild<QLineEdit*>(QStringLiteral("fileNameEdit"))->setText(gameFile_);
    QMetaObject::invokeMethod(dialog, "accept");
  } else if (auto* options = qobject_cast<PrintOptions*>(front)) {
    options->findChild<QRadioButton*>(QStringLiteral("PrintFile"))->setChecked(true);
    options->accept();
  } else if (auto* box = qobject_cast<QMessageBox*>(front)) {
    if (box->icon() == QMessageBox::Information) {
      sheetsPrinted_ = true;
    } else {
      faults_.append(QStringLiteral("A box came up: %1").arg(box->text()));
    }
    box->defaultButton()->click();
  }
}
