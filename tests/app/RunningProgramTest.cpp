// The program itself, started again while it runs.

#include "tests/app/RunningProgram.h"

#include <sys/types.h>

#include <csignal>

namespace {

using testing::HasSubstr;
using testing::IsEmpty;
using testing::Not;
using testing::StartsWith;

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
  EXPECT_EQ(StartAgain({QStringLiteral("--version"), QStringLiteral("a.xml")}), 2);
  EXPECT_THAT(errors, HasSubstr("a.xml"));
  EXPECT_THAT(output, IsEmpty());
  EXPECT_THAT(Log(), IsEmpty());
}

TEST_F(RunningProgram, RefusesAFileWhosePathIsTooLong) {
  EXPECT_EQ(StartAgain({QString(9000, u'a')}), 2);
  EXPECT_THAT(errors, StartsWith("tessarine: The path of this file is too long: /"));
  EXPECT_THAT(Log(), IsEmpty());
}

TEST_F(RunningProgram, RefusesAFileOfAFolderThatIsGone) {
  QProcess start;
  start.setProcessEnvironment(environment);
  start.start(
      QStringLiteral("/bin/sh"),
      {QStringLiteral("-c"),
       QStringLiteral("mkdir \"$0/gone\" && cd \"$0/gone\" && rmdir \"$0/gone\" && "
                      "exec \"$1\" Friday.game.xml"),
       QString::fromStdString(site.Folder.Path()), QStringLiteral(TESSARINE_PROGRAM_FOLDER "/tessarine")});
  ASSERT_TRUE(start.waitForFinished(Limit));
  EXPECT_EQ(start.exitCode(), 2);
  EXPECT_THAT(
      start.readAllStandardError().toStdString(),
      HasSubstr("tessarine: The folder in which this was started is gone, so this file cannot be found: "
                "Friday.game.xml\n"));
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
