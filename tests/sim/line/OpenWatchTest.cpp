#include "sim/line/OpenWatch.h"

#include <gtest/gtest.h>

#include <system_error>

#include "sim/line/PseudoTerminal.h"
#include "tests/support/RawHost.h"

namespace sim {
namespace {

TEST(OpenWatch, NoticesEachOpeningOfALineSinceItWasAskedLast) {
  PseudoTerminal line(19200, Pace::Fast);
  OpenWatch watch(line.SlavePath());
  EXPECT_FALSE(watch.TakeOpening());
  for (int opening = 0; opening < 2; ++opening) {
    RawHost host(line.SlavePath());
    EXPECT_TRUE(watch.TakeOpening());
    host.Write({1});
    EXPECT_EQ(line.ReadByte(Limit), 1);
    EXPECT_FALSE(watch.TakeOpening());
  }
  EXPECT_FALSE(watch.TakeOpening());
}

TEST(OpenWatch, NeedsALineThatIsThere) {
  EXPECT_THROW(OpenWatch("/missing/line"), std::system_error);
}

}  // namespace
}  // namespace sim
