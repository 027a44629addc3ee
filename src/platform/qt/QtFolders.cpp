#include "platform/qt/QtFolders.h"

#include <QCoreApplication>
#include <QDir>
#include <QFileInfo>
#include <QStandardPaths>

QString ProgramFolder(const QString& executableFolder) {
  const QDir folder(executableFolder);
  if (folder.exists(QStringLiteral("scenarios_default.mdb"))) {
    return folder.absolutePath();
  }
  const QString installed = QDir::cleanPath(folder.absoluteFilePath(QStringLiteral("../share/tessarine")));
  const QString canonical = QFileInfo(installed).canonicalFilePath();
  return canonical.isEmpty() ? installed : canonical;
}

std::uint32_t QtFolders::LocalAppData(std::string& path) const {
  const QString folder = QStandardPaths::writableLocation(QStandardPaths::GenericDataLocation);
  if (folder.isEmpty()) {
    return InvalidFolderId;
  }
  if (!QDir().mkpath(folder)) {
    return DoesNotExist;
  }
  path = folder.toStdString();
  return Found;
}

std::string QtFolders::Program() const {
  return ProgramFolder(QCoreApplication::applicationDirPath()).toStdString();
}
