#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <signal.h>

#include "tests/sim/recorder/RecorderHost.h"
#include "tests/support/TemporaryFolder.h"
#include "tests/support/VenueProcess.h"

namespace sim {
namespace {

using testing::HasSubstr;
using testing::StartsWith;

TEST(VenueWithRecorder, KeepsWhatItRecordedAndListsItOnCommand) {
  const TemporaryFolder folder;
  VenueProcess venue({"--fast", "--no-base-unit", "--recorder", "--recorder-kind", "stand-alone",
                      "--recorder-erase-time", "0", "--recorder-folder", folder / "kept"});
  RecorderHost host(venue.ReadDevice("sound recorder"), 115200);
  BeginStandAlone(host);
  EXPECT_EQ(host.Ask({1, 6}), Ack);
  EXPECT_EQ(host.Ask(Bytes{1, 0} + RisingPage + Bytes{RisingCheck}), Ack);
  EXPECT_EQ(host.Ask({0, 0}), Ack);
  EXPECT_EQ(ReadFile(folder / "kept/recording-1/sound-006.wav").substr(44),
            std::string(RisingPage.begin(), RisingPage.end()));
  venue.WriteInput("sounds\n");
  EXPECT_EQ(venue.ReadLine(), "sound 6: 1 pages, 0.01 s");
  host.Speak({.Baud = 19200});
  host.Write({10, 0});
  EXPECT_TRUE(host.IsSilent());
  venue.Signal(SIGTERM);
  EXPECT_EQ(venue.WaitForExit(), 0);
  EXPECT_THAT(venue.RestOfErrors(),
              HasSubstr("sound recorder: the host speaks 19200,8N1 instead of 115200,8N1\n"));
}

TEST(VenueWithRecorder, SaysWhenItCannotKeepRecordings) {
  const TemporaryFolder folder;
  WriteFile(folder / "file", "");
  VenueProcess venue({"--no-base-unit", "--recorder", "--recorder-folder", folder / "file"});
  EXPECT_EQ(venue.WaitForExit(), 1);
  EXPECT_THAT(venue.RestOfErrors(), StartsWith("tessarine-venue: "));
}

}  // namespace
}  // namespace sim
