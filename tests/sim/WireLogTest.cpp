#include "sim/WireLog.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <sstream>
#include <vector>

namespace sim {
namespace {

TEST(WireLog, TellsTimeDeviceDirectionAndBytes) {
  std::ostringstream out;
  WireLog log(&out, "base-unit");
  log.FromHost(0x0A);
  log.ToHost(std::vector<std::uint8_t>{0x00, 0xFF, 0x5c});
  log.FromHost(0xAA, "accepted");
  log.Note("line pulled out");
  const std::string time = " *[0-9]+\\.[0-9]{6} base-unit ";
  EXPECT_THAT(out.str(), testing::MatchesRegex(time + "<- 0A\n" + time + "-> 00 FF 5C\n" + time +
                                               "<- AA accepted\n" + time + "-- line pulled out\n"));
}

TEST(WireLog, WithoutAStreamWritesNothing) {
  WireLog log(nullptr, "base-unit");
  EXPECT_NO_THROW(log.FromHost(1));
}

}  // namespace
}  // namespace sim
