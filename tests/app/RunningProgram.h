#pragma once

#include <gmock/gmock.h>

#include <QProcess>
#include <QTest>
#include <string>

#include "tests/support/DataSite.h"
#include "tests/support/GameFiles.h"

/// The program itself on a data folder of its own.
class RunningProgram : public testing::Test {
 protected:
  static constexpr int Limit = 60'000;  ///< milliseconds that a test waits for what must come

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
