#include "platform/qt/QtFolders.h"

#include <gtest/gtest.h>

#include <QCoreApplication>
#include <QDir>
#include <QFile>
#include <QTemporaryDir>

namespace {

void MakeFile(const QString& path) {
  QFile file(path);
  ASSERT_TRUE(file.open(QIODevice::WriteOnly)) << path.toStdString();
}

class QtFoldersTest : public testing::Test {
 protected:
  ~QtFoldersTest() override { qputenv("XDG_DATA_HOME", dataHome_); }

  void SetDataHome(const QString& path) { qputenv("XDG_DATA_HOME", path.toUtf8()); }

  QString Path(const QString& name) const { return folder_.filePath(name); }

  QtFolders Folders;

 private:
  QByteArray dataHome_ = qgetenv("XDG_DATA_HOME");
  QTemporaryDir folder_;
};

TEST_F(QtFoldersTest, LocalAppDataIsTheUsersDataFolderMadeWhenAbsent) {
  const QString home = Path(QStringLiteral("数据/share"));
  SetDataHome(home);
  std::string path;
  EXPECT_EQ(Folders.LocalAppData(path), Folders::Found);
  EXPECT_EQ(path, home.toStdString());
  EXPECT_TRUE(QDir(home).exists());
  EXPECT_EQ(Folders.LocalAppData(path), Folders::Found);
}

TEST_F(QtFoldersTest, SaysWhenLocalAppDataCannotBeMade) {
  MakeFile(Path(QStringLiteral("file")));
  SetDataHome(Path(QStringLiteral("file/share")));
  std::string path = "unchanged";
  EXPECT_EQ(Folders.LocalAppData(path), Folders::DoesNotExist);
  EXPECT_EQ(path, "unchanged");
}

TEST_F(QtFoldersTest, ProgramIsTheExecutablesFolderWhereTheDefaultDataFilesLie) {
  const QString bin = Path(QStringLiteral("bin"));
  ASSERT_TRUE(QDir().mkpath(bin));
  MakeFile(bin + QStringLiteral("/scenarios_default.mdb"));
  EXPECT_EQ(ProgramFolder(bin), bin);
}

TEST_F(QtFoldersTest, ProgramIsOtherwiseTheSharedFolderBesideTheExecutables) {
  const QString bin = Path(QStringLiteral("usr/bin"));
  const QString share = Path(QStringLiteral("usr/share/tessarine"));
  ASSERT_TRUE(QDir().mkpath(bin));
  EXPECT_EQ(ProgramFolder(bin), share);
  ASSERT_TRUE(QDir().mkpath(share));
  EXPECT_EQ(ProgramFolder(bin), share);
}

TEST_F(QtFoldersTest, ALinkedSharedFolderIsNamedByWhereItLies) {
  const QString bin = Path(QStringLiteral("usr/bin"));
  const QString real = Path(QStringLiteral("store/tessarine"));
  ASSERT_TRUE(QDir().mkpath(bin) && QDir().mkpath(real) && QDir().mkpath(Path(QStringLiteral("usr/share"))));
  ASSERT_TRUE(QFile::link(real, Path(QStringLiteral("usr/share/tessarine"))));
  EXPECT_EQ(ProgramFolder(bin), real);
}

TEST_F(QtFoldersTest, ProgramIsOfTheRunningExecutable) {
  EXPECT_EQ(Folders.Program(), ProgramFolder(QCoreApplication::applicationDirPath()).toStdString());
}

}  // namespace
