#pragma once

#include <filesystem>

/// Skips a test where the files of an old installation, which are no part of the project, are not at hand.
#define SKIP_WITHOUT_OLD_FILES()                                    \
  if (!std::filesystem::exists(TESSARINE_OLD_FILES "/members.mdb")) \
  GTEST_SKIP() << "needs the files of an old installation in " TESSARINE_OLD_FILES
