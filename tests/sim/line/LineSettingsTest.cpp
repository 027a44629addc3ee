#include "sim/line/LineSettings.h"

#include <gtest/gtest.h>
#include <termios.h>

#include <stdexcept>
#include <system_error>

#include "sim/line/FileDescriptor.h"
#include "sim/line/PseudoTerminal.h"
#include "tests/support/RawHost.h"

namespace sim {
namespace {

TEST(LineSettings, AreToldAsSpeedBitsParityAndStopBits) {
  EXPECT_EQ(Text(LineSettings{.Baud = 19200}), "19200,8N1");
  EXPECT_EQ(Text(LineSettings{.Baud = 9600, .DataBits = 7, .Parity = 'E', .StopBits = 2}), "9600,7E2");
  EXPECT_EQ(Text(std::vector<LineSettings>{{.Baud = 19200}, {.Baud = 115200}}), "19200,8N1 or 115200,8N1");
}

TEST(LineSettings, FollowFromTheFlagsOfATerminal) {
  const auto text = [](unsigned int flags) { return Text(LineSettingsFrom(flags, 19200)); };
  EXPECT_EQ(text(CS8 | CREAD | CLOCAL), "19200,8N1");
  EXPECT_EQ(text(CS7), "19200,7N1");
  EXPECT_EQ(text(CS6), "19200,6N1");
  EXPECT_EQ(text(CS5), "19200,5N1");
  EXPECT_EQ(text(CS8 | PARENB), "19200,8E1");
  EXPECT_EQ(text(CS8 | PARENB | PARODD), "19200,8O1");
  EXPECT_EQ(text(CS8 | PARENB | PARODD | CMSPAR), "19200,8M1");
  EXPECT_EQ(text(CS8 | PARENB | CMSPAR), "19200,8S1");
  EXPECT_EQ(text(CS8 | CSTOPB), "19200,8N2");
  EXPECT_EQ(text(CS7 | PARENB | CSTOPB), "19200,7E2");
}

TEST(LineSettings, TellAParityWhoseFlagOfUseIsLost) {
  EXPECT_EQ(LineSettingsFrom(CS8 | PARODD, 19200).Parity, 'O');
  EXPECT_EQ(LineSettingsFrom(CS8 | PARODD | CMSPAR, 19200).Parity, 'M');
  EXPECT_EQ(LineSettingsFrom(CS8 | CMSPAR, 19200).Parity, 'S');
}

TEST(LineSettings, AreReadAsTheyWereSet) {
  const PseudoTerminal line(19200, Pace::Fast);
  RawHost host(line.SlavePath());
  for (const int baud : {300, 1200, 2400, 4800, 9600, 19200, 38400, 57600, 115200, 230400}) {
    for (const char parity : {'N', 'O', 'M', 'S'}) {
      for (const int stopBits : {1, 2}) {
        const LineSettings settings{.Baud = baud, .Parity = parity, .StopBits = stopBits};
        host.Speak(settings);
        EXPECT_EQ(host.Settings(), settings) << Text(settings) << " became " << Text(host.Settings());
      }
    }
  }
}

TEST(LineSettings, OutlastTheClientThatSetThem) {
  const PseudoTerminal line(19200, Pace::Fast);
  EXPECT_EQ(RawHost(line.SlavePath()).Settings(), LineSettings{.Baud = 19200});
  RawHost(line.SlavePath()).Speak({.Baud = 9600, .StopBits = 2});
  EXPECT_EQ(RawHost(line.SlavePath()).Settings(), (LineSettings{.Baud = 9600, .StopBits = 2}));
}

TEST(LineSettings, RefuseSpeedsThatTerminalsDoNotHaveAndFilesThatAreNone) {
  const PseudoTerminal line(19200, Pace::Fast);
  RawHost host(line.SlavePath());
  EXPECT_THROW(host.Speak({.Baud = 19201}), std::invalid_argument);
  EXPECT_THROW(ReadLineSettings(-1), std::system_error);
  EXPECT_THROW(SetRawLine(-1, {}), std::system_error);
}

}  // namespace
}  // namespace sim
