#include <gtest/gtest.h>

#include "sim/line/PseudoTerminal.h"
#include "tests/support/RawHost.h"

namespace sim {
namespace {

using std::chrono::milliseconds;

// Puts down what a line tells of bytes that it does not let through.
class Foreign {
 public:
  explicit Foreign(PseudoTerminal& line) {
    line.OnForeignBytes([this](const LineSettings& host, std::span<const std::uint8_t> bytes, bool begin) {
      Text += sim::Text(host) + (begin ? " begins:" : " goes on:");
      for (const std::uint8_t byte : bytes) {
        Text += ' ' + std::to_string(byte);
      }
      Text += '\n';
    });
  }
  std::string Text;
};

// Those that a pseudo terminal keeps.
class LineCheck : public testing::TestWithParam<LineSettings> {};

TEST_P(LineCheck, LetsNothingThroughThatComesAtOtherSettings) {
  for (const Pace pace : {Pace::Fast, Pace::AsWired}) {
    PseudoTerminal line(19200, pace);
    Foreign foreign(line);
    RawHost host(line.SlavePath());
    host.Speak(GetParam());
    host.Write({1, 0});
    EXPECT_EQ(line.ReadByte(milliseconds(20)), std::nullopt);
    EXPECT_EQ(foreign.Text, Text(GetParam()) + " begins: 1 0\n");
    host.Speak({.Baud = 19200});
    host.Write({7});
    EXPECT_EQ(line.ReadByte(Limit), 7);
  }
}

INSTANTIATE_TEST_SUITE_P(Every, LineCheck,
                         testing::Values(LineSettings{.Baud = 9600}, LineSettings{.Baud = 38400},
                                         LineSettings{.Baud = 19200, .StopBits = 2},
                                         LineSettings{.Baud = 19200, .Parity = 'O'},
                                         LineSettings{.Baud = 19200, .Parity = 'M'},
                                         LineSettings{.Baud = 19200, .Parity = 'S'},
                                         LineSettings{.Baud = 9600, .Parity = 'O', .StopBits = 2}),
                         [](const testing::TestParamInfo<LineSettings>& settings) {
                           std::string name = Text(settings.param);
                           name[name.find(',')] = '_';
                           return name;
                         });

// A pseudo terminal may forget data bits and even parity; what it keeps is checked.
TEST(LineChecks, GoByWhatTheTerminalKeepsOfDataBitsAndEvenParity) {
  for (const LineSettings& settings :
       {LineSettings{.Baud = 19200, .DataBits = 7}, LineSettings{.Baud = 19200, .Parity = 'E'},
        LineSettings{.Baud = 19200, .DataBits = 7, .Parity = 'E'},
        LineSettings{.Baud = 9600, .DataBits = 7, .Parity = 'E', .StopBits = 2}}) {
    PseudoTerminal line(19200, Pace::Fast);
    RawHost host(line.SlavePath());
    host.Speak(settings);
    host.Write({1});
    const bool heard = line.ReadByte(milliseconds(20)).has_value();
    EXPECT_EQ(heard, host.Settings() == LineSettings{.Baud = 19200}) << Text(settings);
  }
}

TEST(LineChecks, LookAtTheSettingsWhenBytesComeAndNotAtTheOpening) {
  PseudoTerminal line(19200, Pace::Fast);
  RawHost host(line.SlavePath());
  host.Write({1});
  EXPECT_EQ(line.ReadByte(Limit), 1);
  host.Speak({.Baud = 57600});
  EXPECT_EQ(line.ReadByte(milliseconds(0)), std::nullopt);
  host.Write({2});
  EXPECT_EQ(line.ReadByte(milliseconds(20)), std::nullopt);
  host.Speak({.Baud = 19200});
  host.Write({3});
  EXPECT_EQ(line.ReadByte(Limit), 3);
}

TEST(LineChecks, TellWhereARunOfForeignBytesBegins) {
  PseudoTerminal line(19200, Pace::Fast);
  Foreign foreign(line);
  RawHost host(line.SlavePath());
  const auto write = [&](int baud, std::uint8_t byte) {
    host.Speak({.Baud = baud});
    host.Write({byte});
    line.ReadByte(milliseconds(0));
  };
  write(9600, 1);
  write(9600, 2);
  write(4800, 3);
  write(19200, 4);
  write(4800, 5);
  EXPECT_EQ(foreign.Text,
            "9600,8N1 begins: 1\n9600,8N1 goes on: 2\n4800,8N1 begins: 3\n4800,8N1 begins: 5\n");
}

TEST(LineChecks, LetEachOfSeveralSettingsThroughAndKeepToTheLatest) {
  const LineSettings slow{.Baud = 19200};
  const LineSettings quick{.Baud = 115200, .StopBits = 2};
  PseudoTerminal line({slow, quick}, Pace::AsWired);
  RawHost host(line.SlavePath());
  EXPECT_EQ(host.Settings(), slow);
  EXPECT_EQ(line.Current(), slow);
  host.Speak(quick);
  host.Write({1});
  EXPECT_EQ(line.ReadByte(Limit), 1);
  EXPECT_EQ(line.Current(), quick);
  EXPECT_EQ(line.DurationOf(1152), milliseconds(100));
  host.Speak({.Baud = 57600});
  host.Write({2});
  EXPECT_EQ(line.ReadByte(milliseconds(20)), std::nullopt);
  EXPECT_EQ(line.Current(), quick);
  host.Speak(slow);
  host.Write({3});
  EXPECT_EQ(line.ReadByte(Limit), 3);
  EXPECT_EQ(line.Current(), slow);
}

TEST(LineChecks, GoByTheSettingsToWhichTheDeviceHasChanged) {
  PseudoTerminal line(9600, Pace::Fast);
  Foreign foreign(line);
  RawHost host(line.SlavePath());
  host.Write({1});
  EXPECT_EQ(line.ReadByte(Limit), 1);
  line.SetBaud(57600);
  host.Write({2});
  EXPECT_EQ(line.ReadByte(milliseconds(20)), std::nullopt);
  EXPECT_EQ(foreign.Text, "9600,8N1 begins: 2\n");
  host.Speak({.Baud = 57600});
  host.Write({3});
  EXPECT_EQ(line.ReadByte(Limit), 3);
}

}  // namespace
}  // namespace sim
