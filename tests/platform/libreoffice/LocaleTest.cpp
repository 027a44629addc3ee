#include <gtest/gtest.h>

#include <cstdlib>
#include <filesystem>

#include "tests/platform/libreoffice/OfficeStart.h"
#include "tests/platform/linux/TemporaryFolder.h"

namespace {

/// A locale of the environment, until the end of the test.
class EnvironmentLocale {
 public:
  explicit EnvironmentLocale(const char* name) { setenv("LC_ALL", name, 1); }
  ~EnvironmentLocale() { unsetenv("LC_ALL"); }
  EnvironmentLocale(const EnvironmentLocale&) = delete;
  EnvironmentLocale& operator=(const EnvironmentLocale&) = delete;
};

TEST(Locale, ThatIsNotInstalledDoesNotKeepFilesFromBeingNamed) {
  const EnvironmentLocale locale("xx_YY.UTF-8");
  const TemporaryFolder folder;
  LibreOffice office(TESSARINE_PROGRAM_FOLDER);
  ASSERT_TRUE(StartAndWait(office));
  const auto document = office.Add(TESSARINE_PROGRAM_FOLDER "/score_card_default.doc");
  for (const char* name : {"/红队 5-李雷.doc", "/Red 5-Zoë.doc"}) {
    const std::string path = folder.Path() + name;
    document->SaveAs(path);
    EXPECT_TRUE(std::filesystem::exists(path)) << path;
  }
  document->Close();
}

}  // namespace
