#pragma once

#include <fcntl.h>
#include <gtest/gtest.h>
#include <sys/stat.h>

#include <ctime>
#include <string>

/// Has a file say that it was last changed at that local time ("YYYY-MM-DD HH:MM:SS").
inline void SetTimeOfChange(const std::string& path, const std::string& localTime) {
  std::tm time{};
  ASSERT_NE(strptime(localTime.c_str(), "%Y-%m-%d %H:%M:%S", &time), nullptr);
  time.tm_isdst = -1;
  const timespec changed{.tv_sec = mktime(&time), .tv_nsec = 0};
  const timespec times[] = {changed, changed};
  ASSERT_EQ(utimensat(AT_FDCWD, path.c_str(), times, 0), 0);
}
