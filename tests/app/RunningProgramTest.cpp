// The program itself, started again while it runs.

#include <gmock/gmock.h>
#include <sys/types.h>

#include <QElapsedTimer>
#include <QProcess>
#include <QTest>
#include <csignal>

#include "tests/support/DataSite.h"
#include "tests/support/GameFiles.h"

namespace {

using testing::HasSubstr;
using testing::IsEmpty;
using testing::Not;
using testing::StartsWith;

constexpr int Limit = 60'000;  ///< milliseconds that a test waits for what must come

class RunningProgram : public testing::Test {
 protected:
  RunningProgram() {
    site.PutDefaultFiles();
    WriteFile(site.Folder / "Friday.game.xml", GameFile(PlayerOf(65), "Free For All"));
    environment.insert(QStringLiteral("XDG_DATA_HOME"), QString::fromStdString(site.Folder.Path()));
    environment.insert(QStringLiteral("XDG_RUNTIME_DIR"), QString::fromStdString(runtime.Path()));
    environment.insert(QStringLiteral("QT_QPA_PLATFORM"),
                       QStringLiteral("offscreen:configfile=" TESSARINE_TEST_SCREENS));
    environment.insert(QStringLiteral("LC_ALL"), QStringLiteral("C.UTF-8"));
    environment.remove(QStringLiteral("LANGUAGE"));
    environment.remove(QStringLiteral("DISPLAY"));
    environment.remove(QStringLiteral("WAYLAND_DISPLAY"));
  }
  ~RunningProgram() override { End(); }

  void Begin(QProcess& process, const QStringList& words) const {
    process.setProcessEnvironment(environment);
    process.setWorkingDirectory(QString::fromStdString(site.Folder.Path()));
    process.start(QStringLiteral(TESSARINE_PROGRAM_FOLDER "/tessarine"), words);
  }

  /// Starts the program that stays.
  void Start(const QStringList& words = {}) {
    Begin(first, words);
    ASSERT_TRUE(first.waitForStarted(Limit));
    ASSERT_TRUE(QTest::qWaitFor([this] { return !Log().empty(); }, Limit));
  }
  void End() {
    first.kill();
    first.waitForFinished(Limit);
  }

  /// Starts it once more; its exit code.
  int StartAgain(const QStringList& words = {}) {
    QProcess second;
    Begin(second, words);
    EXPECT_TRUE(second.waitForFinished(Limit));
    output = second.readAllStandardOutput().toStdString();
    errors = second.readAllStandardError().toStdString();
    EXPECT_EQ(second.exitStatus(), QProcess::NormalExit);
    return second.exitCode();
  }

  std::string Log() const { return ReadFile(site.DataFile("logs/program.log")); }
  bool WaitForLog(const std::string& text) const {
    return QTest::qWaitFor([&] { return Log().find(text) != std::string::npos; }, Limit);
  }

  DataSite site;
  TemporaryFolder runtime;
  QProcessEnvironment environment = QProcessEnvironment::systemEnvironment();
  QProcess first;
  std::string output;
  std::string errors;
};

TEST_F(RunningProgram, TellsItsVersionAndHelpWithoutADisplay) {
  environment.insert(QStringLiteral("QT_QPA_PLATFORM"), QStringLiteral("xcb"));
  EXPECT_EQ(StartAgain({QStringLiteral("--version")}), 0);
  EXPECT_THAT(output, StartsWith("Tessarine 3.54"));
  EXPECT_EQ(StartAgain({QStringLiteral("--help")}), 0);
  EXPECT_THAT(output, StartsWith("Usage: tessarine [FILE]"));
  EXPECT_THAT(errors, IsEmpty());
  EXPECT_THAT(Log(), IsEmpty());
}

TEST_F(RunningProgram, RefusesOtherWords) {
  EXPECT_EQ(StartAgain({QStringLiteral("--verbose")}), 2);
  EXPECT_THAT(errors, HasSubstr("--verbose"));
  EXPECT_EQ(StartAgain({QStringLiteral("a.xml"), QStringLiteral("b.xml")}), 2);
  EXPECT_THAT(output, IsEmpty());
  EXPECT_THAT(Log(), IsEmpty());
}

TEST_F(RunningProgram, LoadsTheGameThatItIsStartedWith) {
  Start({QStringLiteral("Friday.game.xml")});
  EXPECT_TRUE(WaitForLog("OpenFile"));
}

TEST_F(RunningProgram, TakesAGameFromASecondStart) {
  Start();
  ASSERT_TRUE(QTest::qWaitFor([this] { return StartAgain() == 0; }, Limit));
  EXPECT_THAT(Log(), Not(HasSubstr("OpenFile")));
  EXPECT_EQ(StartAgain({QStringLiteral("Friday.game.xml")}), 0);
  EXPECT_TRUE(WaitForLog("OpenFile"));
  EXPECT_THAT(errors, IsEmpty());
  EXPECT_EQ(first.state(), QProcess::Running);
}

TEST_F(RunningProgram, IsNeverJoinedByAnotherOneWhenItHangs) {
  Start();
  ASSERT_TRUE(QTest::qWaitFor([this] { return StartAgain() == 0; }, Limit));
  const std::string before = Log();
  kill(static_cast<pid_t>(first.processId()), SIGSTOP);
  EXPECT_EQ(StartAgain(), 1);
  EXPECT_THAT(errors, HasSubstr("Tessarine runs already, but does not answer."));
  kill(static_cast<pid_t>(first.processId()), SIGCONT);
  EXPECT_EQ(Log(), before);
}

TEST_F(RunningProgram, StartsAgainAfterACrash) {
  Start();
  End();
  const std::string before = Log();
  Start({QStringLiteral("Friday.game.xml")});
  EXPECT_TRUE(WaitForLog("OpenFile"));
  EXPECT_NE(Log(), before);
}

TEST_F(RunningProgram, IsTheOnlyOneOnItsDataForAStartWithoutItsRuntimeFolder) {
  Start();
  environment.remove(QStringLiteral("XDG_RUNTIME_DIR"));
  EXPECT_EQ(StartAgain(), 1);
  EXPECT_THAT(errors, StartsWith("tessarine: Tessarine runs already, but does not answer."));
}

TEST_F(RunningProgram, ComesToTheFrontForAStartWithATokenThatIsTooLong) {
  Start();
  environment.insert(QStringLiteral("DESKTOP_STARTUP_ID"), QString(9000, u'a'));
  EXPECT_EQ(StartAgain(), 0);
}

}  // namespace
