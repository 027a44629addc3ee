#pragma once

#include <gmock/gmock.h>
#include <unistd.h>

#include <cstdlib>
#include <filesystem>
#include <string>
#include <vector>

#include "platform/libreoffice/LibreOffice.h"
#include "tests/platform/libreoffice/OfficeProcesses.h"
#include "tests/platform/libreoffice/OfficeStart.h"
#include "tests/support/TemporaryFolder.h"

inline constexpr const char* DefaultSheetTemplate = TESSARINE_PROGRAM_FOLDER "/score_card_default.doc";

inline std::vector<pid_t> Hosts(pid_t parent = getpid()) {
  return ChildrenOf(parent, "tessarine-office-host");
}

/// Number of LibreOffice profiles in the temporary folder.
inline std::size_t Profiles() {
  std::size_t count = 0;
  for (const auto& entry : std::filesystem::directory_iterator(std::filesystem::temp_directory_path())) {
    count += entry.path().filename().string().rfind("tessarine-office-", 0) == 0 ? 1 : 0;
  }
  return count;
}

/// A running LibreOffice with its own temporary folder. All tests of a suite share it, since starting takes a
/// second.
class Writer : public testing::Test {
 protected:
  static void SetUpTestSuite() {
    temporary_ = new TemporaryFolder;
    setenv("TMPDIR", temporary_->Path().c_str(), 1);
    office_ = new LibreOffice(TESSARINE_PROGRAM_FOLDER);
    ASSERT_TRUE(StartAndWait(*office_));
  }
  static void TearDownTestSuite() {
    delete office_;
    EXPECT_THAT(Hosts(), testing::IsEmpty());
    EXPECT_EQ(Profiles(), 0u);
    unsetenv("TMPDIR");
    delete temporary_;
  }

  /// Has another LibreOffice convert documents, each into a file of the same name in the test's folder.
  void Convert(const std::vector<std::string>& documents, const std::string& format) const {
    std::string command = "soffice -env:UserInstallation=file://" + (folder / "profile") +
                          " --headless --convert-to '" + format + "' --outdir '" + folder.Path() + "'";
    for (const std::string& document : documents) {
      command += " '" + document + "'";
    }
    command += " > /dev/null 2>&1";
    EXPECT_EQ(std::system(command.c_str()), 0);
  }

  /// All text of a saved sheet or template, as read by another LibreOffice.
  std::string TextOf(const std::string& document) const {
    Convert({document}, "txt:Text");
    return ReadFile(std::filesystem::path(document).replace_extension(".txt"));
  }

  static LibreOffice& Office() { return *office_; }

  TemporaryFolder folder;

 private:
  static inline TemporaryFolder* temporary_ = nullptr;
  static inline LibreOffice* office_ = nullptr;
};
