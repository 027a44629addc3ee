#include "sim/line/DeviceLink.h"

#include <gtest/gtest.h>
#include <unistd.h>

#include <fstream>

namespace sim {
namespace {

namespace fs = std::filesystem;

class DeviceLinkTest : public testing::Test {
 protected:
  DeviceLinkTest() {
    std::string pattern = (fs::temp_directory_path() / "device-link-XXXXXX").string();
    folder_ = ::mkdtemp(pattern.data());
    path_ = folder_ / "base-unit";
  }
  ~DeviceLinkTest() override { fs::remove_all(folder_); }

  fs::path folder_;
  fs::path path_;
};

TEST_F(DeviceLinkTest, LeadsToTheDeviceForAsLongAsItLives) {
  {
    const DeviceLink link(path_, "/dev/pts/1000");
    EXPECT_EQ(fs::read_symlink(path_), "/dev/pts/1000");
  }
  EXPECT_FALSE(fs::is_symlink(fs::symlink_status(path_)));
}

TEST_F(DeviceLinkTest, TakesThePlaceOfALinkThatWasLeft) {
  fs::create_symlink("/dev/pts/999", path_);
  const DeviceLink link(path_, "/dev/pts/1000");
  EXPECT_EQ(fs::read_symlink(path_), "/dev/pts/1000");
}

TEST_F(DeviceLinkTest, NeverTakesThePlaceOfAFile) {
  std::ofstream(path_) << "precious";
  EXPECT_THROW(DeviceLink(path_, "/dev/pts/1000"), fs::filesystem_error);
  EXPECT_TRUE(fs::is_regular_file(path_));
}

TEST_F(DeviceLinkTest, LeavesALinkAloneThatSomeoneElseTookOver) {
  {
    const DeviceLink link(path_, "/dev/pts/1000");
    fs::remove(path_);
    fs::create_symlink("/dev/pts/1001", path_);
  }
  EXPECT_EQ(fs::read_symlink(path_), "/dev/pts/1001");
}

}  // namespace
}  // namespace sim
