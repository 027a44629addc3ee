#pragma once

#include <filesystem>

/// Skips a test if the files of an old installation, which are not part of the project, are missing.
#define SKIP_WITHOUT_OLD_FILES()                                    \
  if (!std::filesystem::exists(TESSARINE_OLD_FILES "/members.mdb")) \
  GTEST_SKIP() << "needs the files of an old installation in " TESSARINE_OLD_FILES
