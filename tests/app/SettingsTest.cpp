#include "app/Settings.h"

#include <gmock/gmock.h>

#include <QGroupBox>
#include <QLineEdit>
#include <QListWidget>
#include <QPushButton>
#include <QTest>

#include "tests/fakes/FakeFiles.h"
#include "tests/fakes/FakeMessageBoxes.h"
#include "tests/fakes/FakeSerialDevices.h"

namespace {

using testing::ElementsAre;
using testing::IsEmpty;

class SettingsWindow : public testing::Test {
 protected:
  SettingsWindow() { devices.Ports = {"/dev/ttyS0", "/dev/ttyUSB3"}; }

  void Show(Language language = Language::English) {
    strings.emplace(language);
    window = std::make_unique<Settings>(ini, devices, boxes, *strings, nullptr);
    window->show();
    window->activateWindow();
    Entry().setFocus();
    QCoreApplication::processEvents();
  }

  QLineEdit& Entry() { return *window->findChild<QLineEdit*>(QStringLiteral("CommPortNumber")); }
  QPushButton& Button(const char* name) { return *window->findChild<QPushButton*>(QString::fromUtf8(name)); }

  void LeaveEntryWith(const char* text) {
    Entry().setText(QString::fromUtf8(text));
    QTest::keyClick(&Entry(), Qt::Key_Tab);
    QCoreApplication::processEvents();
  }

  FakeMessageBoxes::Box Fault(const char* text) {
    return {text, "Tessarine", BoxIcon::Critical, BoxButtons::Ok};
  }

  FakeFiles files;
  IniReader ini{files, "/tessarine.ini"};
  FakeSerialDevices devices;
  FakeMessageBoxes boxes;
  std::optional<StringTable> strings;
  std::unique_ptr<Settings> window;
};

TEST_F(SettingsWindow, ShowsTheNumberInForceAndThePorts) {
  files.Put("/tessarine.ini", "[comm]\ncommport= 4\n[ports]\ncom7=/dev/ttyUSB3\ncom8=/dev/gone\n");
  Show();
  EXPECT_EQ(Entry().text(), QStringLiteral("4"));
  EXPECT_EQ(Entry().toolTip(), QStringLiteral("Enter a Comm Port number. Must be a number greater than 0."));
  const auto* list = window->findChild<QListWidget*>(QStringLiteral("AvailablePorts"));
  std::vector<std::string> lines;
  lines.reserve(static_cast<std::size_t>(list->count()));
  for (int row = 0; row < list->count(); ++row) {
    lines.push_back(list->item(row)->text().toStdString());
  }
  EXPECT_THAT(lines, ElementsAre("Available Comm Ports List", "(for display only, enter value above)",
                                 "Comm 1", "Comm 2", "Comm 7"));
  EXPECT_EQ(list->item(4)->toolTip(), QStringLiteral("/dev/ttyUSB3"));
}

TEST_F(SettingsWindow, ShowsTheTwoFixedLinesWithoutAnyPort) {
  devices.Ports.clear();
  Show();
  EXPECT_EQ(window->findChild<QListWidget*>(QStringLiteral("AvailablePorts"))->count(), 2);
  EXPECT_EQ(Entry().text(), QStringLiteral("1"));
}

TEST_F(SettingsWindow, TakesItsCaptionsFromTheStringTable) {
  for (const Language language : {Language::English, Language::SimplifiedChinese}) {
    Show(language);
    EXPECT_EQ(window->windowTitle().toStdString(), strings->Text(160));
    EXPECT_EQ(window->findChild<QGroupBox*>(QStringLiteral("Frame1"))->title().toStdString(),
              strings->Text(161));
    EXPECT_EQ(Button("SaveExit").text().toStdString(), strings->Text(162));
    EXPECT_EQ(Button("Cancel").text().toStdString(), strings->Text(141));
  }
}

TEST_F(SettingsWindow, ChecksTheNumberWhenItsEntryIsLeft) {
  Show();
  LeaveEntryWith("abc");
  EXPECT_THAT(boxes.Boxes, ElementsAre(Fault("Please enter a valid number")));
  EXPECT_TRUE(Entry().hasFocus());
  for (const char* number : {"0", "-3"}) {
    boxes.Boxes.clear();
    LeaveEntryWith(number);
    EXPECT_THAT(boxes.Boxes, ElementsAre(Fault("Please enter a valid number (greater than 0)"))) << number;
    EXPECT_TRUE(Entry().hasFocus());
  }
  boxes.Boxes.clear();
  LeaveEntryWith("7");
  EXPECT_THAT(boxes.Boxes, IsEmpty());
  EXPECT_FALSE(Entry().hasFocus());
}

TEST_F(SettingsWindow, NeverChecksOnCancelOrEscape) {
  Show();
  Entry().setText(QStringLiteral("abc"));
  QTest::mouseClick(&Button("Cancel"), Qt::LeftButton);
  QCoreApplication::processEvents();
  EXPECT_FALSE(window->isVisible());
  Show();
  Entry().setText(QStringLiteral("abc"));
  QTest::keyClick(&Entry(), Qt::Key_Escape);
  QCoreApplication::processEvents();
  EXPECT_FALSE(window->isVisible());
  EXPECT_THAT(boxes.Boxes, IsEmpty());
  EXPECT_THAT(files.Replaced, IsEmpty());
}

TEST_F(SettingsWindow, SavesInNumberFormAndCloses) {
  Show();
  Entry().setText(QStringLiteral("7"));
  QTest::mouseClick(&Button("SaveExit"), Qt::LeftButton);
  EXPECT_FALSE(window->isVisible());
  EXPECT_NE(files.Read("/tessarine.ini").find("commport= 7"), std::string::npos);
  EXPECT_EQ(ini.ReadIni("comm", "commport", ""), "7");
}

TEST_F(SettingsWindow, StaysWithOneBoxWhenABadNumberIsToBeSaved) {
  Show();
  Entry().setText(QStringLiteral("abc"));
  QTest::mouseClick(&Button("SaveExit"), Qt::LeftButton);
  QCoreApplication::processEvents();
  EXPECT_THAT(boxes.Boxes, ElementsAre(Fault("Please enter a valid number")));
  EXPECT_TRUE(window->isVisible());
  EXPECT_THAT(files.Replaced, IsEmpty());
}

TEST_F(SettingsWindow, ReportsANumberThatIsTooLarge) {
  Show();
  Entry().setText(QStringLiteral("99999"));
  QTest::mouseClick(&Button("SaveExit"), Qt::LeftButton);
  EXPECT_THAT(boxes.Boxes, ElementsAre(Fault("Run-time error '6': Overflow")));
}

}  // namespace
