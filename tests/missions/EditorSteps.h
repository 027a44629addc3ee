#pragma once

#include <gmock/gmock.h>

#include <QLabel>
#include <QLineEdit>
#include <QListWidget>
#include <QPlainTextEdit>
#include <QTabBar>

#include "missions/MissionNameEntry.h"
#include "missions/Scenarios.h"
#include "tests/fakes/FakeMessageBoxes.h"
#include "tests/support/Controls.h"
#include "tests/support/WhileModal.h"

/// What is done in the mission editor, on missions "One", "Two" and "Three" in the databases of `Place`.
template <typename Place>
class EditorSteps : public testing::Test {
 protected:
  EditorSteps() {
    venue.PutDefaultFiles();
    venue.ChangeDatabase(
        "scenarios.mdb",
        "DELETE FROM Table1; INSERT INTO Table1 (ID, MissionName, MissionDescription, RespawnPenalty, "
        "GameDuration, PrimaryObjectivePointsB) VALUES (3, 'One', 'First text', 2.5, '10 minutes', 7), "
        "(5, 'Two', 'Second text', 0, '', 0), (9, 'Three', 'Third text', 1, '', 0)");
  }

  /// Shows the editor and returns when it is closed.
  virtual void Execute() = 0;

  /// Opens the editor, runs `act` in it, and closes it by its close box if `act` did not.
  void Open(const std::function<void()>& act) {
    const WhileModal<Scenarios> open([&](Scenarios& opened) {
      window = &opened;
      act();
      opened.close();
    });
    Execute();
    EXPECT_EQ(open.Runs(), 1);
    window = nullptr;
  }

  void Press(const char* button) { ::Press(*window, button); }

  QPlainTextEdit& Memo(const std::string& name) { return ::Find<QPlainTextEdit>(*window, name); }
  QLineEdit& Line(const std::string& name) { return ::Find<QLineEdit>(*window, name); }
  QListWidget& List() { return ::Find<QListWidget>(*window, "MissionSelection1"); }
  std::string ShownName() { return ::Find<QLabel>(*window, "MissionName").text().toStdString(); }
  std::string ShownDescription() { return Memo("Description").toPlainText().toStdString(); }
  std::string EditCaption() { return ::Find<QPushButton>(*window, "Edit").text().toStdString(); }
  bool Locked() { return Memo("Description").isReadOnly(); }

  void Type(const char* box, const std::string& text) { Line(box).setText(QString::fromStdString(text)); }
  void Describe(const std::string& text) { Memo("Description").setPlainText(QString::fromStdString(text)); }

  std::vector<std::string> Entries() {
    std::vector<std::string> entries;
    for (int row = 0; row < List().count(); ++row) {
      entries.push_back(List().item(row)->text().toStdString());
    }
    return entries;
  }

  /// Presses NewButton, types a name and presses `button`.
  void NewMission(const std::string& name, const char* button = "OK") {
    const WhileModal<MissionNameEntry> entry([&](MissionNameEntry& asked) {
      ::Find<QLineEdit>(asked, "MissionEntry").setText(QString::fromStdString(name));
      ::Press(asked, button);
    });
    Press("NewButton");
    EXPECT_EQ(entry.Runs(), 1);
  }

  std::string Stored(const std::string& expression, const std::string& mission) {
    return venue.QueryDatabase("scenarios.mdb",
                               "SELECT " + expression + " FROM Table1 WHERE MissionName = '" + mission + "'");
  }

  std::vector<std::string> Names() {
    std::vector<std::string> names;
    std::string all = venue.QueryDatabase("scenarios.mdb", "SELECT group_concat(MissionName) FROM Table1");
    for (std::size_t at = 0; at <= all.size();) {
      const std::size_t comma = std::min(all.find(',', at), all.size());
      names.push_back(all.substr(at, comma - at));
      at = comma + 1;
    }
    return names;
  }

  static FakeMessageBoxes::Box Saved() {
    return {"Mission Saved", "Mission Setup", BoxIcon::Information, BoxButtons::Ok};
  }
  static FakeMessageBoxes::Box SaveError() {
    return {"Error occured when saving Mission. Please check the entered data.", "Mission Save Error",
            BoxIcon::Exclamation, BoxButtons::Ok};
  }
  static FakeMessageBoxes::Box NotSaved() {
    return {"Data is not saved! Save it now?", "Exit without Save", BoxIcon::Exclamation, BoxButtons::YesNo};
  }
  static FakeMessageBoxes::Box EntryError(const std::string& text) {
    return {text, "Entry Error", BoxIcon::Exclamation, BoxButtons::Ok};
  }

  Place venue;
  Scenarios* window = nullptr;
};
