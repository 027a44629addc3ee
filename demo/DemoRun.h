#pragma once

#include <QDir>
#include <QMainWindow>
#include <QStringList>
#include <QTableView>
#include <functional>

#include "demo/AudienceEyes.h"
#include "demo/DemoMembers.h"
#include "demo/Operator.h"

/// Where the demo's game comes from.
enum class DemoSource { BaseUnit, Radio };

/// One game of an evening, with the real buttons in the real windows: downloads it, assigns the members who
/// came without their buttons, enters the mission's results, commits and saves the game, and prints the
/// active players' score sheets to files. Leaves the board as text, after the download and at the end,
/// pictures, and the pages that phones get.
class DemoRun {
 public:
  DemoRun(QMainWindow& window, DemoSource source, const QDir& folder);

  /// Returns one line for each thing that went wrong; empty on success.
  QStringList Run();

 private:
  /// After which step, as part of the file names.
  enum class Step { Download, End };

  void PullGame();
  /// Changes the port's number in the settings.
  void UsePort(int number);
  /// In the window of the radio, searches for guns, gets their scores if the game comes from them, and leaves
  /// a picture.
  void ManageGuns();

  void AssignMembers();
  void AssignMember(int row, const DemoMember& member);
  /// First row of the board without a member's name, -1 if there is none.
  int RowWithoutName() const;
  bool IsOnBoard(const DemoMember& member) const;
  QString PlayerIn(int row) const;

  void PlayMission();
  void CommitGame();
  void SaveGame(const QString& name);
  void PrintSheets();

  void WriteBoard(Step step);
  void WriteFile(const QString& name, const QString& text);
  void ShowBoard();
  void ShowDetails();
  void ShowMembers();

  QAction& Item(const char* name) const;
  /// Chooses an item of the menu, whose command may show a window.
  std::function<void()> ByMenu(const char* item) const;

  QMainWindow& window_;
  DemoSource source_;
  QDir folder_;
  QTableView& board_;
  QTableView& teams_;
  Operator operator_;
  AudienceEyes audience_;
};
