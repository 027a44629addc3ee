#pragma once

#include <QDir>
#include <QMainWindow>
#include <QStringList>
#include <QTimer>

/// Where the demo's game comes from.
enum class DemoSource { BaseUnit, Radio };

/// Plays the operator for one game: presses the real buttons of the real windows, waits for the end, saves
/// the game through the menu and the file dialog, prints the score sheets of the active players to files, and
/// leaves the board as text and picture.
class DemoRun : public QObject {
  Q_OBJECT

 public:
  DemoRun(QMainWindow& window, DemoSource source, const QDir& folder);

  /// Returns what went wrong, one line each; empty when all of it happened.
  QStringList Run();

 private:
  void PullGame();
  /// In the window that is open: finds the guns, fetches their scores and closes it.
  void PullByRadio();
  void SaveGame();
  void PrintSheets();
  void WriteBoard();
  void WriteFile(const QString& name, const QString& text);
  /// Answers whatever is open in front of the main window: the file dialog with `gameFile_`, the print
  /// options with files as output, a box, which is a fault here unless it tells the end of printing, with its
  /// default button.
  void AnswerDialogs();

  QMainWindow& window_;
  DemoSource source_;
  QDir folder_;
  QString gameFile_;
  QTimer watch_;
  QStringList faults_;
  bool sheetsPrinted_ = false;  ///< the box that tells the end of printing came
};
