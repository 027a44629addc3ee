#pragma once

#include <QDir>
#include <QMainWindow>
#include <QStringList>
#include <QTimer>

/// Where the demo's game comes from.
enum class DemoSource { BaseUnit, Radio };

/// Acts as the operator for one game: presses the real buttons in the real windows, waits for the download,
/// saves the game through the menu and the file dialog, prints the active players' score sheets to files, and
/// leaves the board as text and as a picture.
class DemoRun : public QObject {
  Q_OBJECT

 public:
  DemoRun(QMainWindow& window, DemoSource source, const QDir& folder);

  /// Returns one line for each thing that went wrong; empty on success.
  QStringList Run();

 private:
  void PullGame();
  /// In the open radio window, searches for guns, fetches their scores and closes the window.
  void PullByRadio();
  void SaveGame();
  void PrintSheets();
  void WriteBoard();
  void WriteFile(const QString& name, const QString& text);
  /// Answers whatever dialog is open: the file dialog with `gameFile_`, the print options with output to
  /// files, a box with its default button. Any box except the one at the end of printing counts as an error.
  void AnswerDialogs();

  QMainWindow& window_;
  DemoSource source_;
  QDir folder_;
  QString gameFile_;
  QTimer watch_;
  QStringList faults_;
  bool sheetsPrinted_ = false;  ///< the box at the end of printing was shown
};
