#pragma once

#include <gmock/gmock.h>

#include <QBuffer>
#include <QImage>
#include <QLabel>
#include <QLineEdit>

#include "members/DatePicker.h"
#include "members/Members.h"
#include "members/PictureBox.h"
#include "tests/app/Venue.h"
#include "tests/platform/qt/WhileModal.h"

/// A picture file of one colour.
inline std::string PictureFile(const QColor& colour, const char* format = "JPG", QSize size = QSize(80, 60)) {
  QImage image(size, QImage::Format_RGB32);
  image.fill(colour);
  QByteArray bytes;
  QBuffer buffer(&bytes);
  image.save(&buffer, format);
  return bytes.toStdString();
}

/// The window of the members, opened from the main window on Rhys Morgan (1), Alice "Mole" Belmont (2), Sean
/// O'Brien (5) and 王小明 (9).
class MembersWindow : public testing::Test {
 protected:
  MembersWindow() {
    venue.PutDefaultFiles();
    Sql("INSERT INTO Members (ContactID, FirstName, LastName, NickName, Clan, Birthdate, DateJoined, City) VALUES "
        "(1, 'Rhys', 'Morgan', NULL, 'Red Dragons', '1961-04-12 00:00:00', '2010-03-01 09:05:00', 'Cardiff'), "
        "(2, 'Alice', 'Belmont', 'Mole', '', NULL, NULL, NULL), "
        "(5, 'Sean', 'O''Brien', 'Shamrock', NULL, NULL, NULL, NULL), "
        "(9, '小明', '王', NULL, NULL, NULL, NULL, NULL)");
    venue.Start();
  }

  void Sql(const std::string& sql) { venue.ChangeDatabase("members.mdb", sql); }

  std::string Stored(const std::string& column, int member) {
    return venue.QueryDatabase("members.mdb",
                               "SELECT " + column + " FROM Members WHERE ContactID = " + std::to_string(member));
  }

  /// Opens the window, does `act` in it, and closes it by its close box where `act` did not.
  void Open(const std::function<void()>& act, const char* menuItem = "mnuManageMembers") {
    const WhileModal<Members> open([&](Members& opened) {
      window = &opened;
      act();
      opened.close();
    });
    venue.Trigger(menuItem);
    EXPECT_EQ(open.Runs(), 1);
    window = nullptr;
  }

  void Press(const char* button) { ::Press(*window, button); }
  QLineEdit& Line(const std::string& name) { return ::Find<QLineEdit>(*window, name); }
  std::string Text(const std::string& name) { return Line(name).text().toStdString(); }
  std::string Shown(const std::string& name) { return ::Find<QLabel>(*window, name).text().toStdString(); }
  PictureBox& Photo() { return ::Find<PictureBox>(*window, "MemberPhoto"); }
  QColor PhotoColour() { return Photo().Picture().pixelColor(10, 10); }

  /// The operator types over what an entry holds.
  void Enter(const std::string& name, const std::string& text) {
    Line(name).setFocus();
    Line(name).selectAll();
    QTest::keyClick(&Line(name), Qt::Key_Delete);
    QTest::keyClicks(&Line(name), QString::fromStdString(text));
  }

  void SearchFor(const std::string& text) {
    Enter("SearchText", text);
    Type(*window, Qt::Key_Tab);
  }

  static FakeMessageBoxes::Box Fault(int number, const std::string& text) {
    return {"Run-time error '" + std::to_string(number) + "': " + text, "Tessarine", BoxIcon::Critical,
            BoxButtons::Ok};
  }

  Venue venue;
  Members* window = nullptr;
};
