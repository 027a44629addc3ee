#include "sim/line/WireLog.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <mutex>
#include <sstream>
#include <streambuf>
#include <string_view>
#include <thread>
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

// Takes its time over each row, so that rows of two threads would mix if they could.
class SlowBuffer : public std::streambuf {
 public:
  std::string Text;

 protected:
  std::streamsize xsputn(const char* bytes, std::streamsize count) override {
    for (const char byte : std::string_view(bytes, static_cast<std::size_t>(count))) {
      {
        const std::scoped_lock lock(mutex_);
        Text += byte;
      }
      std::this_thread::yield();
    }
    return count;
  }

 private:
  std::mutex mutex_;
};

TEST(WireLog, SharesItsStreamWithLogsOnOtherThreads) {
  constexpr int rows = 500;
  SlowBuffer buffer;
  std::ostream out(&buffer);
  const auto write = [&out](const char* device) {
    WireLog log(&out, device);
    for (int i = 0; i < rows; ++i) {
      log.FromHost(0x0A);
    }
  };
  std::thread other(write, "1-wire");
  write("base-unit");
  other.join();
  std::istringstream lines(buffer.Text);
  int whole = 0;
  for (std::string line; std::getline(lines, line); ++whole) {
    ASSERT_THAT(line, testing::MatchesRegex(" *[0-9]+\\.[0-9]{6} (base-unit|1-wire) <- 0A"));
  }
  EXPECT_EQ(whole, 2 * rows);
}

TEST(WireLog, WithoutAStreamWritesNothing) {
  WireLog log(nullptr, "base-unit");
  EXPECT_NO_THROW(log.FromHost(1));
}

}  // namespace
}  // namespace sim
