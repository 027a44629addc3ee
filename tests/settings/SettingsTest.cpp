#include "settings/Settings.h"

#include <gmock/gmock.h>

#include <QApplication>
#include <QGroupBox>
#include <QLabel>
#include <QLineEdit>
#include <QListWidget>
#include <optional>

#include "tests/fakes/FakeFiles.h"
#include "tests/fakes/FakeMessageBoxes.h"
#include "tests/fakes/FakeSerialDevices.h"
#include "tests/support/Controls.h"

namespace {

using testing::ElementsAre;
using testing::IsEmpty;

class SettingsWindow : public testing::Test {
 protected:
  SettingsWindow() { devices.Ports = {"/dev/ttyS0", "/dev/ttyUSB3"}; }

  void Open(Language language = Language::English) {
    strings.emplace(language);
    window = std::make_unique<Settings>(ini, devices, boxes, *strings, nullptr);
    Show(*window);
  }

  QLineEdit& Entry() const { return Find<QLineEdit>(*window, "CommPortNumber"); }
  QListWidget& Ports() const { return Find<QListWidget>(*window, "AvailablePorts"); }

  /// The operator types over what the entry holds.
  void Enter(const char* text) const {
    Entry().setFocus();
    Entry().selectAll();
    QTest::keyClicks(&Entry(), QString::fromUtf8(text));
  }

  void LeaveEntryWith(const char* text) const {
    Enter(text);
    Type(*window, Qt::Key_Tab);
    QCoreApplication::processEvents();
  }

  static FakeMessageBoxes::Box Fault(const char* text) {
    return {text, "Tessarine", BoxIcon::Critical, BoxButtons::Ok};
  }
  const FakeMessageBoxes::Box noNumber = Fault("Please enter a valid number");
  const FakeMessageBoxes::Box tooSmall = Fault("Please enter a valid number (greater than 0)");

  FakeFiles files;
  IniReader ini{files, "/tessarine.ini"};
  FakeSerialDevices devices;
  FakeMessageBoxes boxes;
  std::optional<StringTable> strings;
  std::unique_ptr<Settings> window;
};

TEST_F(SettingsWindow, TakesItsCaptionsFromTheStringTable) {
  for (const Language language : {Language::English, Language::SimplifiedChinese}) {
    Open(language);
    EXPECT_EQ(window->windowTitle().toStdString(), strings->Text(160));
    EXPECT_EQ(Find<QGroupBox>(*window, "Frame1").title().toStdString(), strings->Text(161));
    EXPECT_EQ(Find<QPushButton>(*window, "SaveExit").text().toStdString(), strings->Text(162));
    EXPECT_EQ(Find<QPushButton>(*window, "Cancel").text().toStdString(), strings->Text(141));
    EXPECT_EQ(Find<QLabel>(*window, "CommLabel").buddy(), &Entry());
  }
}

TEST_F(SettingsWindow, ShowsTheNumberInForceWithItsHint) {
  files.Put("/tessarine.ini", "[comm]\ncommport= 4\n");
  Open();
  EXPECT_EQ(Entry().text(), QStringLiteral("4"));
  EXPECT_EQ(Entry().toolTip(), QStringLiteral("Enter a Comm Port number. Must be a number greater than 0."));
  EXPECT_TRUE(Entry().hasFocus());
}

TEST_F(SettingsWindow, ShowsPort1WithoutASetting) {
  Open();
  EXPECT_EQ(Entry().text(), QStringLiteral("1"));
}

TEST_F(SettingsWindow, ListsThePortsThatExist) {
  files.Put("/tessarine.ini",
            "[ports]\ncom7=/dev/ttyUSB3\ncom8=/dev/gone\ncom100=/dev/ttyS0\ncom101=/dev/ttyS0\n");
  Open();
  std::vector<std::string> lines;
  for (int row = 0; row < Ports().count(); ++row) {
    lines.push_back(Ports().item(row)->text().toStdString());
  }
  EXPECT_THAT(lines, ElementsAre("Available Comm Ports List", "(for display only, enter value above)",
                                 "Comm 1", "Comm 2", "Comm 7", "Comm 100"));
  EXPECT_EQ(Ports().item(4)->toolTip(), QStringLiteral("/dev/ttyUSB3"));
}

TEST_F(SettingsWindow, ShowsTheTwoFixedLinesWithoutAnyPort) {
  devices.Ports.clear();
  Open();
  EXPECT_EQ(Ports().count(), 2);
}

TEST_F(SettingsWindow, LetsNobodyChooseInTheList) {
  Open();
  QTest::mouseClick(Ports().viewport(), Qt::LeftButton, {}, Ports().visualItemRect(Ports().item(3)).center());
  EXPECT_THAT(Ports().selectedItems(), IsEmpty());
  EXPECT_EQ(Entry().text(), QStringLiteral("1"));
}

TEST_F(SettingsWindow, RefusesToLeaveATextThatIsNoNumber) {
  Open();
  LeaveEntryWith("abc");
  EXPECT_THAT(boxes.Boxes, ElementsAre(noNumber));
  EXPECT_TRUE(Entry().hasFocus());
  boxes.Boxes.clear();
  LeaveEntryWith("");
  LeaveEntryWith("7x");
  EXPECT_THAT(boxes.Boxes, ElementsAre(noNumber, noNumber));
  EXPECT_TRUE(Entry().hasFocus());
}

TEST_F(SettingsWindow, RefusesToLeaveANumberBelow1) {
  Open();
  for (const char* number : {"0", "-3", "0.4"}) {
    boxes.Boxes.clear();
    LeaveEntryWith(number);
    EXPECT_THAT(boxes.Boxes, ElementsAre(tooSmall)) << number;
    EXPECT_TRUE(Entry().hasFocus());
  }
}

TEST_F(SettingsWindow, LetsAGoodNumberBeLeft) {
  Open();
  LeaveEntryWith("7");
  EXPECT_THAT(boxes.Boxes, IsEmpty());
  EXPECT_TRUE(Ports().hasFocus());
}

TEST_F(SettingsWindow, ChecksWhenTheMouseLeavesTheEntryForTheList) {
  Open();
  Enter("abc");
  QTest::mouseClick(Ports().viewport(), Qt::LeftButton);
  QCoreApplication::processEvents();
  EXPECT_THAT(boxes.Boxes, ElementsAre(noNumber));
  EXPECT_TRUE(Entry().hasFocus());
}

TEST_F(SettingsWindow, DoesNotCheckWhenAnotherWindowComesToTheFront) {
  Open();
  Enter("abc");
  QWidget other;
  Show(other);
  QCoreApplication::processEvents();
  EXPECT_FALSE(window->isActiveWindow());
  EXPECT_THAT(boxes.Boxes, IsEmpty());
}

TEST_F(SettingsWindow, NeverChecksOnCancel) {
  Open();
  Enter("abc");
  Press(*window, "Cancel");
  QCoreApplication::processEvents();
  EXPECT_FALSE(window->isVisible());
  EXPECT_THAT(boxes.Boxes, IsEmpty());
  EXPECT_THAT(files.Replaced, IsEmpty());
}

TEST_F(SettingsWindow, NeverChecksOnCancelByKeys) {
  Open();
  Enter("abc");
  Type(*window, Qt::Key_Backtab);
  QCoreApplication::processEvents();
  ASSERT_TRUE(Find<QPushButton>(*window, "Cancel").hasFocus());
  Type(*window, Qt::Key_Space);
  QCoreApplication::processEvents();
  EXPECT_FALSE(window->isVisible());
  EXPECT_THAT(boxes.Boxes, IsEmpty());
}

TEST_F(SettingsWindow, NeverChecksOnEscape) {
  Open();
  Enter("-3");
  Type(*window, Qt::Key_Escape);
  QCoreApplication::processEvents();
  EXPECT_FALSE(window->isVisible());
  EXPECT_THAT(boxes.Boxes, IsEmpty());
  EXPECT_THAT(files.Replaced, IsEmpty());
}

TEST_F(SettingsWindow, NeverChecksOnItsCloseBox) {
  Open();
  Enter("abc");
  EXPECT_TRUE(window->close());
  QCoreApplication::processEvents();
  EXPECT_FALSE(window->isVisible());
  EXPECT_THAT(boxes.Boxes, IsEmpty());
  EXPECT_THAT(files.Replaced, IsEmpty());
}

TEST_F(SettingsWindow, SavesInNumberFormAndCloses) {
  files.Put("/tessarine.ini", "[other]\nkey=kept\n[comm]\ncommport=1\n");
  Open();
  Enter("7");
  Press(*window, "SaveExit");
  EXPECT_FALSE(window->isVisible());
  EXPECT_EQ(files.Read("/tessarine.ini"), "[other]\nkey=kept\n[comm]\ncommport= 7\n");
  EXPECT_THAT(boxes.Boxes, IsEmpty());
}

TEST_F(SettingsWindow, SavesByReturn) {
  Open();
  Enter("12");
  Type(*window, Qt::Key_Return);
  EXPECT_FALSE(window->isVisible());
  EXPECT_EQ(ini.ReadIni("comm", "commport", ""), "12");
}

TEST_F(SettingsWindow, RoundsWhatItSaves) {
  Open();
  Enter("2.5");
  Press(*window, "SaveExit");
  EXPECT_EQ(ini.ReadIni("comm", "commport", ""), "2");
}

TEST_F(SettingsWindow, StaysWithOneBoxWhenABadNumberIsToBeSaved) {
  for (const Qt::Key key : {Qt::Key_unknown, Qt::Key_Return}) {
    Open();
    boxes.Boxes.clear();
    Enter("abc");
    if (key == Qt::Key_unknown) {
      Press(*window, "SaveExit");
    } else {
      Type(*window, key);
    }
    QCoreApplication::processEvents();
    EXPECT_THAT(boxes.Boxes, ElementsAre(noNumber));
    EXPECT_TRUE(window->isVisible());
    EXPECT_TRUE(Entry().hasFocus());
    EXPECT_THAT(files.Replaced, IsEmpty());
  }
}

TEST_F(SettingsWindow, ReportsANumberThatIsTooLarge) {
  const FakeMessageBoxes::Box overflow = Fault("Run-time error '6': Overflow");
  Open();
  Enter("99999");
  Press(*window, "SaveExit");
  EXPECT_THAT(boxes.Boxes, ElementsAre(overflow));
  EXPECT_TRUE(window->isVisible());
  LeaveEntryWith("1e300");
  EXPECT_THAT(boxes.Boxes, ElementsAre(overflow, overflow));
  EXPECT_THAT(files.Replaced, IsEmpty());
}

}  // namespace
