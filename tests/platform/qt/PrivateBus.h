#pragma once

#include <gtest/gtest.h>

#include <QDBusConnection>
#include <QFile>
#include <QProcess>
#include <QTemporaryDir>

/// A message bus of a test's own, on which no other program is.
class PrivateBus {
 public:
  PrivateBus() {
    QFile settings(folder_.filePath(QStringLiteral("bus.conf")));
    EXPECT_TRUE(settings.open(QIODevice::WriteOnly));
    settings.write(
        "<busconfig><type>session</type><listen>unix:tmpdir=/tmp</listen>"
        "<policy context=\"default\"><allow send_destination=\"*\" eavesdrop=\"true\"/>"
        "<allow eavesdrop=\"true\"/><allow own=\"*\"/></policy></busconfig>");
    settings.close();
    daemon_.start(QStringLiteral("dbus-daemon"),
                  {QStringLiteral("--config-file=%1").arg(settings.fileName()), QStringLiteral("--nofork"),
                   QStringLiteral("--nopidfile"), QStringLiteral("--print-address")});
    EXPECT_TRUE(daemon_.waitForReadyRead(60000)) << daemon_.errorString().toStdString();
    address_ = QString::fromLocal8Bit(daemon_.readLine()).trimmed();
  }

  ~PrivateBus() {
    for (const QString& name : names_) {
      QDBusConnection::disconnectFromBus(name);
    }
    daemon_.kill();
    daemon_.waitForFinished();
  }

  PrivateBus(const PrivateBus&) = delete;
  PrivateBus& operator=(const PrivateBus&) = delete;

  /// A new connection, as of another program.
  QDBusConnection Connect() {
    names_.append(QStringLiteral("test %1 of %2").arg(names_.size()).arg(address_));
    return QDBusConnection::connectToBus(address_, names_.constLast());
  }

 private:
  const QTemporaryDir folder_;
  QProcess daemon_;
  QString address_;
  QStringList names_;
};
