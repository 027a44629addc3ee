#include "app/ConversionWithProgress.h"

#include <gtest/gtest.h>

#include <QApplication>
#include <QLabel>
#include <QTimer>
#include <filesystem>

#include "tests/app/Controls.h"
#include "tests/platform/linux/TemporaryFolder.h"

namespace {

class ConversionWindow : public testing::TestWithParam<Language> {
 protected:
  void SetUp() override {
    if (!std::filesystem::exists(OldFile)) {
      GTEST_SKIP() << "needs the files of an old installation in " TESSARINE_OLD_FILES;
    }
    std::filesystem::copy_file(OldFile, Path);
  }

  const std::string OldFile = TESSARINE_OLD_FILES "/members.mdb";
  TemporaryFolder folder;
  const std::string Path = folder / "members.mdb";
};

TEST_P(ConversionWindow, TellsFileAndRowsUntilItIsDone) {
  const StringTable strings(GetParam());
  ConversionWithProgress conversion(strings, std::chrono::milliseconds(0));
  QStringList seen;
  QTimer watch;
  QObject::connect(&watch, &QTimer::timeout, [&seen] {
    for (const QWidget* window : QApplication::topLevelWidgets()) {
      if (const auto* progress = qobject_cast<const QProgressDialog*>(window);
          progress && progress->isVisible()) {
        seen += progress->labelText();
      }
    }
  });
  watch.start(0);
  conversion.Convert(Path, "Members", TESSARINE_PROGRAM_FOLDER "/members_default.mdb");
  ASSERT_FALSE(seen.isEmpty());
  EXPECT_TRUE(seen.front().contains(QStringLiteral("members.mdb"))) << seen.front().toStdString();
  for (const QWidget* window : QApplication::topLevelWidgets()) {
    EXPECT_EQ(qobject_cast<const QProgressDialog*>(window), nullptr);
  }
}

INSTANTIATE_TEST_SUITE_P(Languages, ConversionWindow,
                         testing::Values(Language::English, Language::SimplifiedChinese));

}  // namespace
