#include <gtest/gtest.h>
#include <signal.h>

#include "tests/sim/pic24f/LoaderHost.h"
#include "tests/support/TemporaryFolder.h"
#include "tests/support/VenueProcess.h"

namespace sim {
namespace {

TEST(VenueWithPic24f, IsTheDeviceThatItsOptionsDescribe) {
  const TemporaryFolder folder;
  VenueProcess venue({"--fast", "--no-base-unit", "--pic24f", "--pic24f-identity", "32769", "--pic24f-pages",
                      "2", "--pic24f-eeprom-words", "1", "--pic24f-user-reset", "256", "--pic24f-boot-delay",
                      "258"});
  LoaderHost host(venue.ReadDevice("PIC24F bootloader"));
  EXPECT_EQ(host.Ask(AskIdentity, 13),
            (Bytes{0x55, 0x55, 0x01, 0x01, 0x00, 0x00, 0xFF, 0x01, 0x80, 0x00, 0x00, 0x7E, 0x04}));
  // The one word of EEPROM, at 0xFFFFFE.
  EXPECT_EQ(host.Ask({0x55, 0x55, 0x05, 0x04, 0x01, 0xFE, 0xFF, 0xFF, 0xFF, 0x04}, 12),
            (Bytes{0x55, 0x55, 0x05, 0x04, 0x01, 0xFE, 0xFF, 0xFF, 0xFF, 0xFF, 0x01, 0x04}));
  venue.WriteInput("pic24f save " + (folder / "memory") + "\n");
  EXPECT_EQ(venue.ReadLine(), "saved 1024 instructions");
  const std::string memory = ReadFile(folder / "memory");
  EXPECT_EQ(memory.size(), 4096U);
  EXPECT_EQ(memory.substr(512, 12), std::string("\xFF\xFF\xFF\x00\x05\x00\x00\x00\xFF\xFF\xFF\x00", 12));
  host.Write(RunApplication + AskVersion);
  EXPECT_TRUE(host.IsSilent());
  venue.WriteInput("pic24f reset\n");
  EXPECT_EQ(venue.ReadLine(), "reset");
  EXPECT_EQ(host.Ask(AskVersion, Version.size()), Version);
  venue.Signal(SIGTERM);
  EXPECT_EQ(venue.WaitForExit(), 0);
  EXPECT_EQ(venue.RestOfErrors(), "");
}

}  // namespace
}  // namespace sim
