#include "platform/qt/QtPipedProgram.h"

#include <fcntl.h>
#include <gmock/gmock.h>
#include <unistd.h>

#include <QCoreApplication>
#include <filesystem>

#include "platform/linux/Descriptor.h"
#include "platform/qt/QtEventPump.h"
#include "tests/support/TemporaryFolder.h"

namespace {

using namespace std::chrono_literals;

class Piped : public testing::Test {
 protected:
  void SetUp() override {
    program.OnOutput = [this](std::string_view bytes) { output += bytes; };
    program.OnEnd = [this](int code) {
      ++ends;
      exitCode = code;
    };
  }

  void WaitForEnd() {
    EXPECT_EQ(events.WaitFor([this] { return ends > 0; }, 20s), WaitResult::Met);
  }

  QtEventPump events;
  QtPipedProgram program;
  std::string output;
  int ends = 0;
  int exitCode = -1;
};

TEST_F(Piped, HearsWhatItIsSent) {
  program.Start({"/bin/cat"}, 0ms);
  program.Write("one ");
  program.Write("two");
  EXPECT_EQ(events.WaitFor([this] { return output == "one two"; }, 20s), WaitResult::Met);
  EXPECT_EQ(program.Unread(), 0U);
  EXPECT_EQ(ends, 0);
}

TEST_F(Piped, HasNoEnvironment) {
  program.Start({"/usr/bin/env"}, 0ms);
  WaitForEnd();
  EXPECT_EQ(output, "");
}

TEST_F(Piped, GetsNoHandleButItsStreams) {
  const Descriptor forgotten(open("/dev/null", O_RDONLY));  // without O_CLOEXEC
  ASSERT_GT(forgotten.Number(), 2);
  program.Start({"/bin/ls", "/proc/self/fd"}, 0ms);
  WaitForEnd();
  EXPECT_EQ(output, "0\n1\n2\n3\n");  // the last is that of the listing itself
}

TEST_F(Piped, ReportsAProgramThatIsNotThere) {
  program.Start({"/nowhere/program"}, 0ms);
  EXPECT_EQ(ends, 0);
  WaitForEnd();
  EXPECT_EQ(exitCode, PipedProgram::NotStarted);
  program.Write("into the void");
  EXPECT_EQ(program.Unread(), 0U);
}

TEST_F(Piped, TellsWithWhichCodeTheProgramEnded) {
  program.Start({"/bin/sh", "-c", "exit 3"}, 0ms);
  WaitForEnd();
  EXPECT_EQ(exitCode, 3);
}

TEST_F(Piped, TellsThatTheProgramWasKilled) {
  program.Start({"/bin/sh", "-c", "kill -9 $$"}, 0ms);
  WaitForEnd();
  EXPECT_EQ(exitCode, PipedProgram::Killed);
}

TEST_F(Piped, IsStartedAfterThePause) {
  program.Start({"/bin/true"}, 10ms);
  EXPECT_EQ(ends, 0);
  WaitForEnd();
  EXPECT_EQ(ends, 1);
}

TEST_F(Piped, NeverDelaysAWriterWhoIsNotRead) {
  program.Start({"/bin/sleep", "1000"}, 0ms);
  program.Write(std::string(4'000'000, 'x'));
  events.DoEvents();
  EXPECT_GT(program.Unread(), 3'000'000U);
}

TEST_F(Piped, SaysNothingMoreWhenItIsStopped) {
  program.Start({"/bin/sh", "-c", "echo started; exec sleep 1000"}, 0ms);
  ASSERT_EQ(events.WaitFor([this] { return output == "started\n"; }, 20s), WaitResult::Met);
  program.Stop();
  program.Start({"/bin/echo", "again"}, 0ms);
  WaitForEnd();
  EXPECT_EQ(output, "started\nagain\n");
  EXPECT_EQ(ends, 1);
}

QStringList warnings;

TEST_F(Piped, EndsWithTheApplicationWithoutAWord) {
  program.Start({"/bin/sh", "-c", "echo started; exec sleep 1000"}, 0ms);
  ASSERT_EQ(events.WaitFor([this] { return output == "started\n"; }, 20s), WaitResult::Met);
  program.Stop();
  const QList<QProcess*> owned = QCoreApplication::instance()->findChildren<QProcess*>();
  ASSERT_FALSE(owned.isEmpty());
  EXPECT_EQ(owned.last()->state(), QProcess::Running);
  warnings.clear();
  const QtMessageHandler before = qInstallMessageHandler(
      [](QtMsgType, const QMessageLogContext&, const QString& text) { warnings.append(text); });
  qDeleteAll(owned);
  qInstallMessageHandler(before);
  EXPECT_EQ(warnings, QStringList());
}

TEST_F(Piped, IsTheProgramThatWasKeptWhenItsFileHasBeenReplaced) {
  const TemporaryFolder folder;
  const std::string path = folder / "helper";
  std::filesystem::copy_file("/bin/echo", path);
  const KeptProgram kept(path);
  QtPipedProgram updated(&kept);
  updated.OnOutput = program.OnOutput;
  updated.OnEnd = program.OnEnd;
  std::filesystem::remove(path);
  std::filesystem::copy_file("/bin/true", path);
  updated.Start({path, "as before"}, 0ms);
  WaitForEnd();
  EXPECT_EQ(output, "as before\n");
  updated.Start({"/bin/echo", "another"}, 0ms);
  EXPECT_EQ(events.WaitFor([this] { return ends == 2; }, 20s), WaitResult::Met);
  EXPECT_EQ(output, "as before\nanother\n");
}

TEST_F(Piped, CanBeStartedAgainWhenItEnds) {
  int starts = 1;
  program.OnEnd = [&](int /*exitCode*/) {
    if (starts++ < 3) {
      program.Start({"/bin/echo", "x"}, 0ms);
    } else {
      ++ends;
    }
  };
  program.Start({"/bin/echo", "x"}, 0ms);
  WaitForEnd();
  EXPECT_EQ(output, "x\nx\nx\n");
}

}  // namespace
