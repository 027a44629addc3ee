#include "sim/line/LineInput.h"

#include <fcntl.h>
#include <gtest/gtest.h>
#include <unistd.h>

#include <array>
#include <string_view>

#include "sim/line/FileDescriptor.h"

namespace sim {
namespace {

using Lines = std::vector<std::string>;

class LineInputTest : public testing::Test {
 protected:
  static std::array<int, 2> MakePipe() {
    std::array<int, 2> ends{};
    EXPECT_EQ(::pipe2(ends.data(), O_CLOEXEC), 0);
    return ends;
  }

  void Write(std::string_view text) {
    EXPECT_EQ(::write(writer_.Get(), text.data(), text.size()), static_cast<ssize_t>(text.size()));
  }

  std::array<int, 2> ends_ = MakePipe();
  FileDescriptor reader_{ends_[0]};
  FileDescriptor writer_{ends_[1]};
  LineInput input_{ends_[0]};
};

TEST_F(LineInputTest, CutsWhatComesInIntoLines) {
  Write("one\n\ntwo\nth");
  EXPECT_EQ(input_.Read(), (Lines{"one", "", "two"}));
  Write("r");
  EXPECT_EQ(input_.Read(), Lines{});
  Write("ee\n");
  EXPECT_EQ(input_.Read(), Lines{"three"});
  EXPECT_FALSE(input_.HasEnded());
}

TEST_F(LineInputTest, GivesALastLineWithoutAnEndAtTheEnd) {
  Write("one\nlast");
  EXPECT_EQ(input_.Read(), Lines{"one"});
  writer_.Close();
  EXPECT_EQ(input_.Read(), Lines{"last"});
  EXPECT_TRUE(input_.HasEnded());
  EXPECT_EQ(input_.Read(), Lines{});
}

TEST(LineInput, HasEndedWhenItCannotBeRead) {
  LineInput input(-1);
  EXPECT_EQ(input.Read(), Lines{});
  EXPECT_TRUE(input.HasEnded());
}

}  // namespace
}  // namespace sim
