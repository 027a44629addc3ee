#include "platform/qt/QtSerialDevices.h"

#include <gtest/gtest.h>
#include <unistd.h>

#include <QTemporaryDir>
#include <algorithm>
#include <fstream>

namespace {

TEST(NaturalLess, OrdersNamesByTheNumbersInThem) {
  const std::vector<std::string> inOrder{"/dev/ttyACM0", "/dev/ttyS1",   "/dev/ttyS2",    "/dev/ttyS02",
                                         "/dev/ttyS9",   "/dev/ttyS10",  "/dev/ttyS10a2", "/dev/ttyS10a11",
                                         "/dev/ttyS100", "/dev/ttyUSB0", "/dev/ttyUSB12"};
  std::vector<std::string> names(inOrder.rbegin(), inOrder.rend());
  std::sort(names.begin(), names.end(), NaturalLess);
  // "ttyS02" and "ttyS2" have the same number, so plain text order decides.
  std::vector<std::string> expected = inOrder;
  std::swap(expected[2], expected[3]);
  EXPECT_EQ(names, expected);
}

TEST(NaturalLess, ANameIsAfterItsBeginningAndNotBeforeItself) {
  EXPECT_TRUE(NaturalLess("ttyS", "ttyS0"));
  EXPECT_FALSE(NaturalLess("ttyS0", "ttyS"));
  EXPECT_FALSE(NaturalLess("ttyS1", "ttyS1"));
  EXPECT_TRUE(NaturalLess("", "a"));
}

TEST(NaturalLess, TakesNumbersOfAnyLength) {
  EXPECT_TRUE(NaturalLess("p99999999999999999998", "p99999999999999999999"));
  EXPECT_TRUE(NaturalLess("p99999999999999999999", "p100000000000000000000"));
  EXPECT_TRUE(NaturalLess("p000", "p0001"));
}

TEST(QtSerialDevices, ADeviceExistsUnderItsNameAndUnderALinkToIt) {
  const QTemporaryDir folder;
  const std::string link = folder.filePath(QStringLiteral("usb-Adapter-if00")).toStdString();
  ASSERT_EQ(::symlink("/dev/null", link.c_str()), 0);
  const QtSerialDevices devices;
  EXPECT_TRUE(devices.Exists("/dev/null"));
  EXPECT_TRUE(devices.Exists(link));
}

TEST(QtSerialDevices, FilesFoldersAndBrokenLinksAreNoDevices) {
  const QTemporaryDir folder;
  const std::string file = folder.filePath(QStringLiteral("file")).toStdString();
  const std::string broken = folder.filePath(QStringLiteral("broken")).toStdString();
  std::ofstream(file) << "text";
  ASSERT_EQ(::symlink("/dev/no-such-port", broken.c_str()), 0);
  const QtSerialDevices devices;
  EXPECT_FALSE(devices.Exists(file));
  EXPECT_FALSE(devices.Exists(broken));
  EXPECT_FALSE(devices.Exists("/dev"));
  EXPECT_FALSE(devices.Exists("/dev/no-such-port"));
  EXPECT_FALSE(devices.Exists(""));
}

}  // namespace
