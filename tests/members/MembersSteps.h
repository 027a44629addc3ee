#pragma once

#include <gmock/gmock.h>

#include <QLabel>
#include <QLineEdit>

#include "core/game/Game.h"
#include "members/Members.h"
#include "members/PictureBox.h"
#include "tests/fakes/FakeMessageBoxes.h"
#include "tests/support/Controls.h"
#include "tests/support/WhileModal.h"

/// What is done in the window of the members, with the databases of `Place`, on Rhys Morgan (1), Alice "Mole"
/// Belmont (2), Sean "Shamrock" O'Brien (5) and 王小明 (9).
template <typename Place>
class MembersSteps : public testing::Test {
 protected:
  MembersSteps() {
    venue.PutDefaultFiles();
    Sql("INSERT INTO Members (ContactID, FirstName, LastName, NickName, Clan, Birthdate, DateJoined, City) "
        "VALUES (1, 'Rhys', 'Morgan', NULL, 'Red Dragons', '1961-04-12 00:00:00', '2010-03-01 09:05:00', "
        "'Cardiff'), "
        "(2, 'Alice', 'Belmont', 'Mole', '', NULL, NULL, NULL), "
        "(5, 'Sean', 'O''Brien', 'Shamrock', NULL, NULL, NULL, NULL), "
        "(9, '小明', '王', NULL, NULL, NULL, NULL, NULL)");
    venue.ButtonSwipe = [this] { return swiped; };
  }

  /// Shows the window and returns when it is closed.
  virtual void Execute() = 0;

  void Sql(const std::string& sql) { venue.ChangeDatabase("members.mdb", sql); }
  std::string Query(const std::string& sql) { return venue.QueryDatabase("members.mdb", sql); }

  /// A column of one member, read through a separate connection.
  std::string Stored(const std::string& column, int member) {
    return Query("SELECT " + column + " FROM Members WHERE ContactID = " + std::to_string(member));
  }

  /// Opens the window, runs `act` in it, and closes it by its close box if `act` did not.
  void Open(const std::function<void()>& act) {
    const WhileModal<Members> open([&](Members& opened) {
      window = &opened;
      EXPECT_TRUE(QTest::qWaitFor([this] { return QApplication::activeWindow() == window; }));
      act();
      opened.close();
    });
    Execute();
    EXPECT_EQ(open.Runs(), 1);
    window = nullptr;
  }

  void Press(const char* button) { ::Press(*window, button); }
  QLineEdit& Line(const std::string& name) { return ::Find<QLineEdit>(*window, name); }
  std::string Text(const std::string& name) { return Line(name).text().toStdString(); }
  std::string Shown(const std::string& name) { return ::Find<QLabel>(*window, name).text().toStdString(); }
  PictureBox& Photo() { return ::Find<PictureBox>(*window, "MemberPhoto"); }

  /// Types over the contents of an entry.
  void Enter(const std::string& name, const std::string& text) {
    Line(name).setFocus();
    Line(name).selectAll();
    QTest::keyClick(&Line(name), Qt::Key_Delete);
    const QString typed = QString::fromStdString(text);
    if (QString::fromLatin1(typed.toLatin1()) == typed) {
      QTest::keyClicks(&Line(name), typed);
    } else {
      Line(name).insert(typed);  // has no key on the keyboard
    }
  }

  /// Types a name to search for and leaves the box with the Tab key.
  void SearchFor(const std::string& text) {
    Enter("SearchText", text);
    Type(*window, Qt::Key_Tab);
    QApplication::processEvents();  // a failure is reported once the focus has moved
  }

  /// The last names of all rows that the arrows go through, each followed by a blank.
  std::string Found() {
    std::string names;
    Press("DataFirst");
    for (std::string place; place != Shown("DataPlace"); Press("DataNext")) {
      place = Shown("DataPlace");
      names += Text("LastNameEntry") + " ";
    }
    return names;
  }

  static FakeMessageBoxes::Box Fault(int number, const std::string& text) {
    return {"Run-time error '" + std::to_string(number) + "': " + text, "Tessarine", BoxIcon::Critical,
            BoxButtons::Ok};
  }

  Place venue;
  std::string swiped = NoDallasId;  ///< the button on the reader
  Members* window = nullptr;
};
