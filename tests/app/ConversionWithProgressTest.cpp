#include "app/ConversionWithProgress.h"

#include <gtest/gtest.h>

#include <QApplication>
#include <QLabel>
#include <QPushButton>
#include <QTimer>
#include <algorithm>
#include <filesystem>

#include "platform/linux/LinuxFiles.h"
#include "tests/support/Controls.h"
#include "tests/support/ConversionAnswers.h"
#include "tests/support/ReaderWords.h"
#include "tests/support/TemporaryFolder.h"

namespace {

class ConversionWindow : public testing::TestWithParam<Language> {
 protected:
  ConversionWindow() {
    WriteFile(Path, std::string(4096, '\0'));
    WriteFile(folder / "written", MembersAsRead({{7, "Ada"}}));
    WriteFile(Reader, "#!/bin/sh\ncat '" + (folder / "written") + "'\n");
    std::filesystem::permissions(Reader, std::filesystem::perms(0755));
  }

  TemporaryFolder folder;
  LinuxFiles disk;
  const std::string Path = folder / "members.mdb";
  const std::string Reader = folder / "reader";
};

TEST_P(ConversionWindow, StandsWhileTheReaderIsSilent) {
  WriteFile(Reader, "#!/bin/sh\nsleep 2\ncat '" + (folder / "written") + "'\n");
  const StringTable strings(GetParam());
  ConversionWithProgress conversion(strings, disk, std::chrono::milliseconds(90), Reader);
  QString first;
  bool offersToCancel = false;
  QTimer watch;
  QObject::connect(&watch, &QTimer::timeout, [&] {
    for (const QWidget* window : QApplication::topLevelWidgets()) {
      const auto* progress = qobject_cast<const QProgressDialog*>(window);
      if (progress != nullptr && progress->isVisible() && first.isEmpty()) {
        first = progress->labelText();
        offersToCancel = progress->findChild<QPushButton*>() != nullptr;
      }
    }
  });
  watch.start(0);
  ConversionAnswers steps;
  conversion.Convert({Path, "Members", TESSARINE_PROGRAM_FOLDER "/members_default.mdb", folder / "none"},
                     steps);
  EXPECT_TRUE(
      first.contains(GetParam() == Language::English ? QStringLiteral(": 0 rows") : QStringLiteral("：0 行")))
      << first.toStdString();
  EXPECT_FALSE(offersToCancel);
}

/// Asks whether a window stands over its question.
class WindowDuringQuestion : public ConversionAnswers {
 public:
  bool Stood = false;
  bool StoodBefore = false;
  bool Asked = false;

  WindowDuringQuestion() {
    QObject::connect(&watch_, &QTimer::timeout, [this] { StoodBefore |= Stands(); });
    watch_.start(0);
  }

  bool GoOnWithout(const std::vector<NotTakenOver>& /*values*/) override {
    Asked = true;
    Stood = Stands();
    return true;
  }

 private:
  static bool Stands() {
    const QWidgetList windows = QApplication::topLevelWidgets();
    return std::any_of(windows.begin(), windows.end(), [](const QWidget* window) {
      return qobject_cast<const QProgressDialog*>(window) != nullptr;
    });
  }

  QTimer watch_;
};

TEST_P(ConversionWindow, GoesBeforeAQuestion) {
  std::string words = MembersAsRead({{7, "Ada"}});
  words.insert(words.find("RI") + 10, "U");
  WriteFile(folder / "written", words);
  WriteFile(Reader, "#!/bin/sh\nsleep 2\ncat '" + (folder / "written") + "'\n");
  const StringTable strings(GetParam());
  ConversionWithProgress conversion(strings, disk, std::chrono::milliseconds(0), Reader);
  WindowDuringQuestion steps;
  conversion.Convert({Path, "Members", TESSARINE_PROGRAM_FOLDER "/members_default.mdb", folder / "none"},
                     steps);
  EXPECT_TRUE(steps.StoodBefore);
  EXPECT_TRUE(steps.Asked);
  EXPECT_FALSE(steps.Stood);
}

TEST_P(ConversionWindow, TellsFileAndRowsUntilItIsDone) {
  const StringTable strings(GetParam());
  ConversionWithProgress conversion(strings, disk, std::chrono::milliseconds(0), Reader);
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
  ConversionAnswers steps;
  conversion.Convert({Path, "Members", TESSARINE_PROGRAM_FOLDER "/members_default.mdb", folder / "none"},
                     steps);
  ASSERT_FALSE(seen.isEmpty());
  EXPECT_EQ(seen.front(), GetParam() == Language::English
                              ? QStringLiteral("Converting members.mdb of an old installation: 1 rows")
                              : QStringLiteral("正在转换旧安装的数据库 members.mdb：1 行"));
  for (const QWidget* window : QApplication::topLevelWidgets()) {
    EXPECT_EQ(qobject_cast<const QProgressDialog*>(window), nullptr);
  }
}

/// Shows the progress itself, and stops after a while.
class StepsElsewhere : public ConversionAnswers {
 public:
  bool ShowsProgress() const override { return true; }
  bool KeepOn() override {
    for (const QWidget* window : QApplication::topLevelWidgets()) {
      Stood |= qobject_cast<const QProgressDialog*>(window) != nullptr;
    }
    return ConversionAnswers::KeepOn();
  }

  bool Stood = false;
};

TEST_P(ConversionWindow, DoesNotStandWhereTheProgressIsShownElsewhereAndCanBeStopped) {
  WriteFile(Reader, "#!/bin/sh\ncat '" + (folder / "written") + "'\nexec sleep 1000\n");
  const StringTable strings(GetParam());
  ConversionWithProgress conversion(strings, disk, std::chrono::milliseconds(0), Reader);
  StepsElsewhere steps;
  steps.StopAt = 3;
  EXPECT_THROW(
      conversion.Convert({Path, "Members", TESSARINE_PROGRAM_FOLDER "/members_default.mdb", folder / "none"},
                         steps),
      OldDatabaseStopped);
  EXPECT_FALSE(steps.Stood);
}

INSTANTIATE_TEST_SUITE_P(Languages, ConversionWindow,
                         testing::Values(Language::English, Language::SimplifiedChinese));

}  // namespace
