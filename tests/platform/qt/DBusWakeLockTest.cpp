#include "platform/qt/DBusWakeLock.h"

#include <gtest/gtest.h>

#include <QDBusConnection>
#include <QDBusMessage>
#include <QDBusObjectPath>
#include <QDBusVirtualObject>
#include <QElapsedTimer>
#include <string>
#include <vector>

#include "platform/qt/QtEventPump.h"
#include "tests/platform/qt/PrivateBus.h"

using namespace std::chrono_literals;

namespace {

/// A service of the desktop that keeps the calls it gets and answers requests with its `Answer`.
class DesktopService : public QDBusVirtualObject {
 public:
  DesktopService(PrivateBus& bus, const char* name, const char* path) : connection_(bus.Connect()) {
    EXPECT_TRUE(connection_.registerVirtualObject(QString::fromLatin1(path), this, QDBusConnection::SubPath));
    EXPECT_TRUE(connection_.registerService(QString::fromLatin1(name)));
  }

  QVariant Answer;
  bool Silent = false;  ///< requests wait for AnswerNow
  std::vector<QDBusMessage> Calls;

  std::string Members() const {
    std::string members;
    for (const QDBusMessage& call : Calls) {
      members += (members.empty() ? "" : " ") + call.member().toStdString();
    }
    return members;
  }

  const QDBusConnection& Connection() const { return connection_; }

  void AnswerNow() { connection_.send(Calls.front().createReply(Answer)); }

  bool handleMessage(const QDBusMessage& message, const QDBusConnection& connection) override {
    Calls.push_back(message);
    if (message.member() == QStringLiteral("Inhibit") && !Silent) {
      connection.send(message.createReply(Answer));
    }
    return true;
  }

  QString introspect(const QString&) const override { return {}; }

 private:
  QDBusConnection connection_;
};

class WakeLockOnABus : public testing::Test {
 protected:
  void WaitForCalls(const DesktopService& service, std::size_t count) {
    EXPECT_EQ(pump.WaitFor([&] { return service.Calls.size() >= count; }, 60s), WaitResult::Met)
        << service.Members();
  }

  /// What the program sent so far has arrived at the service, and the answers to it at the program.
  void Settle(const DesktopService& service) {
    for (const QDBusConnection& connection : {program, service.Connection(), program}) {
      Ping(connection);
    }
  }

  /// What was sent on a connection before is behind the bus now, and what the bus had for it has arrived.
  void Ping(const QDBusConnection& connection) {
    const QDBusMessage ping =
        QDBusMessage::createMethodCall(QStringLiteral("org.freedesktop.DBus"), QStringLiteral("/"),
                                       QStringLiteral("org.freedesktop.DBus"), QStringLiteral("GetId"));
    EXPECT_EQ(connection.call(ping).type(), QDBusMessage::ReplyMessage);
    pump.DoEvents();
  }

  PrivateBus bus;
  QtEventPump pump;
  QDBusConnection program = bus.Connect();
};

class WakeLockOfScreenSaver : public WakeLockOnABus {
 protected:
  WakeLockOfScreenSaver() { service.Answer = 4711U; }

  DesktopService service{bus, "org.freedesktop.ScreenSaver", "/org/freedesktop/ScreenSaver"};
  DBusWakeLock lock{[this] { return program; }};
};

TEST_F(WakeLockOfScreenSaver, IsHeldInTheProgramsNameAndTakenBackByItsNumber) {
  lock.Hold("Firmware download");
  WaitForCalls(service, 1);
  EXPECT_EQ(service.Calls[0].interface(), QStringLiteral("org.freedesktop.ScreenSaver"));
  EXPECT_EQ(service.Calls[0].path(), QStringLiteral("/org/freedesktop/ScreenSaver"));
  EXPECT_EQ(service.Calls[0].arguments(),
            (QVariantList{QStringLiteral("Tessarine"), QStringLiteral("Firmware download")}));
  Settle(service);
  lock.Release();
  WaitForCalls(service, 2);
  EXPECT_EQ(service.Members(), "Inhibit UnInhibit");
  EXPECT_EQ(service.Calls[1].arguments(), QVariantList{4711U});
}

TEST_F(WakeLockOfScreenSaver, IsHeldOnceAndUntilTheLastRelease) {
  lock.Hold("one");
  lock.Hold("two");
  WaitForCalls(service, 1);
  Settle(service);
  lock.Release();
  Settle(service);
  EXPECT_EQ(service.Members(), "Inhibit");
  lock.Release();
  WaitForCalls(service, 2);
  EXPECT_EQ(service.Members(), "Inhibit UnInhibit");
}

TEST_F(WakeLockOfScreenSaver, IsTakenBackWhenTheAnswerComesAfterTheRelease) {
  service.Silent = true;
  lock.Hold("short");
  WaitForCalls(service, 1);
  lock.Release();
  Settle(service);
  EXPECT_EQ(service.Members(), "Inhibit");
  service.AnswerNow();
  WaitForCalls(service, 2);
  EXPECT_EQ(service.Members(), "Inhibit UnInhibit");
}

TEST_F(WakeLockOfScreenSaver, OfAnEarlierTurnIsTakenBackWhileTheNextOneHolds) {
  service.Silent = true;
  lock.Hold("first");
  WaitForCalls(service, 1);
  lock.Release();
  lock.Hold("second");
  WaitForCalls(service, 2);
  service.AnswerNow();
  WaitForCalls(service, 3);
  EXPECT_EQ(service.Members(), "Inhibit Inhibit UnInhibit");
}

TEST_F(WakeLockOfScreenSaver, CanBeHeldAgain) {
  for (std::size_t turn = 0; turn < 3; ++turn) {
    const StayAwake awake(lock, "again");
    WaitForCalls(service, 2 * turn + 1);
    Settle(service);
  }
  WaitForCalls(service, 6);
  EXPECT_EQ(service.Members(), "Inhibit UnInhibit Inhibit UnInhibit Inhibit UnInhibit");
}

TEST_F(WakeLockOnABus, IsHeldThroughThePortalAndTakenBackByItsHandle) {
  DesktopService portal(bus, "org.freedesktop.portal.Desktop", "/org/freedesktop/portal/desktop");
  portal.Answer =
      QVariant::fromValue(QDBusObjectPath(QStringLiteral("/org/freedesktop/portal/desktop/request/1")));
  DBusWakeLock lock([this] { return program; });
  lock.Hold("Firmware download");
  WaitForCalls(portal, 1);
  EXPECT_EQ(portal.Calls[0].interface(), QStringLiteral("org.freedesktop.portal.Inhibit"));
  EXPECT_EQ(portal.Calls[0].signature(), QStringLiteral("sua{sv}"));
  EXPECT_EQ(portal.Calls[0].arguments().value(1), QVariant(12U));
  Settle(portal);
  lock.Release();
  WaitForCalls(portal, 2);
  EXPECT_EQ(portal.Calls[1].interface(), QStringLiteral("org.freedesktop.portal.Request"));
  EXPECT_EQ(portal.Calls[1].member(), QStringLiteral("Close"));
  EXPECT_EQ(portal.Calls[1].path(), QStringLiteral("/org/freedesktop/portal/desktop/request/1"));
}

TEST_F(WakeLockOnABus, IsSilentWhereNoServiceIs) {
  DBusWakeLock lock([this] { return program; });
  lock.Hold("nobody");
  Ping(program);
  lock.Release();
  lock.Hold("nobody");
  lock.Release();
  Ping(program);
}

TEST(WakeLockWithoutABus, IsSilentAndDoesNotWait) {
  QtEventPump pump;
  DBusWakeLock lock([] {
    return QDBusConnection::connectToBus(QStringLiteral("unix:path=/nowhere/bus"), QStringLiteral("none"));
  });
  QElapsedTimer time;
  time.start();
  lock.Hold("nobody");
  pump.DoEvents();
  lock.Release();
  EXPECT_LT(time.elapsed(), 10000);
  QDBusConnection::disconnectFromBus(QStringLiteral("none"));
}

}  // namespace
