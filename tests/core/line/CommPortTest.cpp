#include "core/line/CommPort.h"

#include <gmock/gmock.h>

#include "tests/fakes/FakeFiles.h"
#include "tests/fakes/FakeMessageBoxes.h"
#include "tests/fakes/FakeSerialDevices.h"
#include "tests/fakes/FakeSerialPort.h"

namespace {

using testing::ElementsAre;
using testing::IsEmpty;

constexpr const char* Line = "19200,N,8,1";

class OpeningThePort : public testing::Test {
 protected:
  OpeningThePort() { devices.Ports = {"/dev/ttyS0", "/dev/ttyUSB0"}; }

  void PutIni(const std::string& text) { files.Put("/tessarine.ini", text); }

  FakeFiles files;
  IniReader ini{files, "/tessarine.ini"};
  FakeSerialDevices devices;
  FakeSerialPort port;
  FakeMessageBoxes boxes;
  StringTable strings{Language::English};
  std::function<void()> settings = [] {};
  CommPort commPort{port, ini, devices, boxes, strings, [this] { settings(); }};
};

TEST_F(OpeningThePort, TakesTheFirstByDefault) {
  EXPECT_TRUE(commPort.OpenCommPort(Line));
  EXPECT_THAT(port.Log, ElementsAre("Open /dev/ttyS0 19200,N,8,1"));
}

TEST_F(OpeningThePort, TakesTheNumberOfTheSettings) {
  PutIni("[comm]\r\ncommport= 2\r\n");
  EXPECT_TRUE(commPort.OpenCommPort(Line));
  EXPECT_EQ(port.Device, "/dev/ttyUSB0");
}

TEST_F(OpeningThePort, TakesTheDeviceThatIsNamedForTheNumber) {
  PutIni("[comm]\ncommport=2\n[ports]\ncom2=/dev/pts/7\n");
  EXPECT_TRUE(commPort.OpenCommPort(Line));
  EXPECT_EQ(port.Device, "/dev/pts/7");
}

TEST_F(OpeningThePort, ClosesItFirstWhenItIsOpen) {
  ASSERT_TRUE(commPort.OpenCommPort(Line));
  ASSERT_TRUE(commPort.OpenCommPort(Line));
  EXPECT_THAT(port.Log, ElementsAre("Open /dev/ttyS0 19200,N,8,1", "Close", "Open /dev/ttyS0 19200,N,8,1"));
}

TEST_F(OpeningThePort, AsksAndGoesOnWithTheNumberSavedThen) {
  port.FailNextOpen(8005);
  settings = [this] { PutIni("[comm]\ncommport=2\n"); };
  EXPECT_TRUE(commPort.OpenCommPort(Line));
  EXPECT_THAT(boxes.Boxes, ElementsAre(FakeMessageBoxes::Box{
                               "Communications port could not be opened. Please select a valid port and "
                               "press OK, or press Cancel to "
                               "proceed with communications disabled.",
                               "Comm Port Error", BoxIcon::Exclamation, BoxButtons::OkCancel}));
  EXPECT_EQ(port.Device, "/dev/ttyUSB0");
  EXPECT_FALSE(commPort.CommDisabled());
}

TEST_F(OpeningThePort, ClosesItAgainWhenTheSettingsLeaveItOpen) {
  port.FailNextOpen(8005);
  settings = [this] { port.Open("/dev/ttyUSB0", Line); };
  EXPECT_TRUE(commPort.OpenCommPort(Line));
  EXPECT_THAT(port.Log, ElementsAre("Open /dev/ttyS0 19200,N,8,1 failed 8005",
                                    "Open /dev/ttyUSB0 19200,N,8,1", "Close", "Open /dev/ttyS0 19200,N,8,1"));
}

TEST_F(OpeningThePort, AsksInTheLanguageOfTheTable) {
  const StringTable chinese(Language::SimplifiedChinese);
  port.FailNextOpen(8002);
  CommPort(port, ini, devices, boxes, chinese, [] {}).OpenCommPort(Line);
  ASSERT_EQ(boxes.Boxes.size(), 1U);
  EXPECT_EQ(boxes.Boxes[0].Text, chinese.Text(121));
  EXPECT_EQ(boxes.Boxes[0].Title, chinese.Text(122));
}

TEST_F(OpeningThePort, AsksAgainUntilCancel) {
  PutIni("[comm]\ncommport=9\n");
  boxes.Answers = {BoxAnswer::Ok, BoxAnswer::Ok, BoxAnswer::Cancel};
  int shown = 0;
  settings = [&shown] { ++shown; };
  EXPECT_FALSE(commPort.OpenCommPort(Line));
  EXPECT_EQ(boxes.Boxes.size(), 3u);
  EXPECT_EQ(shown, 2);
  EXPECT_FALSE(port.PortOpen());
  EXPECT_TRUE(commPort.CommDisabled());
}

TEST_F(OpeningThePort, AsksWhenTheNumberIsInvalid) {
  for (const char* number :
       {"abc", "2abc", "", "0", "-3", "3", "32767", "32768", "-32769", "65538", "99999", "1e99"}) {
    PutIni(std::string("[comm]\ncommport=") + number + "\n");
    boxes.Boxes.clear();
    boxes.Answers = {BoxAnswer::Cancel};
    EXPECT_FALSE(commPort.OpenCommPort(Line)) << number;
    EXPECT_EQ(boxes.Boxes.size(), 1u) << number;
  }
  EXPECT_THAT(port.Log, IsEmpty());
}

TEST_F(OpeningThePort, TakesTheFirstWhenTheSettingsLackTheNumber) {
  for (const char* text : {"", "[comm]\n", "[other]\ncommport=2\n"}) {
    PutIni(text);
    EXPECT_TRUE(commPort.OpenCommPort(Line));
    EXPECT_EQ(port.Device, "/dev/ttyS0") << text;
  }
}

TEST_F(OpeningThePort, WorksAgainAfterAnEarlierCancel) {
  port.FailNextOpen(8002);
  boxes.Answers = {BoxAnswer::Cancel};
  ASSERT_FALSE(commPort.OpenCommPort(Line));
  EXPECT_TRUE(commPort.OpenCommPort(Line));
  EXPECT_TRUE(port.PortOpen());
}

TEST_F(OpeningThePort, ClosesItOnlyWhenItIsOpen) {
  commPort.CloseIfOpen();
  EXPECT_THAT(port.Log, IsEmpty());
  commPort.OpenCommPort(Line);
  commPort.CloseIfOpen();
  EXPECT_FALSE(port.PortOpen());
}

}  // namespace
