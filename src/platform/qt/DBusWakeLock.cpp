#include "platform/qt/DBusWakeLock.h"

#include <QDBusConnection>
#include <QDBusMessage>
#include <QDBusObjectPath>
#include <QDBusPendingCall>
#include <QDBusPendingCallWatcher>
#include <QDBusPendingReply>
#include <QVariantMap>
#include <utility>
#include <vector>

namespace {

/// A service that can be asked, and how to take the request back.
struct Service {
  QDBusMessage (*Request)(const QString& reason);
  QString AnswerSignature;
  QDBusMessage (*Undo)(const QVariant& answer);
};

const QString& Portal() {
  static const QString name = QStringLiteral("org.freedesktop.portal.Desktop");
  return name;
}

const QString& ScreenSaver() {
  static const QString name = QStringLiteral("org.freedesktop.ScreenSaver");
  return name;
}

QDBusMessage PortalRequest(const QString& reason) {
  constexpr quint32 suspend = 4;
  constexpr quint32 idle = 8;
  return QDBusMessage::createMethodCall(Portal(), QStringLiteral("/org/freedesktop/portal/desktop"),
                                        QStringLiteral("org.freedesktop.portal.Inhibit"),
                                        QStringLiteral("Inhibit"))
         << QString() << (suspend | idle) << QVariantMap{{QStringLiteral("reason"), reason}};
}

QDBusMessage PortalUndo(const QVariant& answer) {
  return QDBusMessage::createMethodCall(Portal(), answer.value<QDBusObjectPath>().path(),
                                        QStringLiteral("org.freedesktop.portal.Request"),
                                        QStringLiteral("Close"));
}

QDBusMessage ScreenSaverCall(const QString& method) {
  return QDBusMessage::createMethodCall(ScreenSaver(), QStringLiteral("/org/freedesktop/ScreenSaver"),
                                        ScreenSaver(), method);
}

QDBusMessage ScreenSaverRequest(const QString& reason) {
  return ScreenSaverCall(QStringLiteral("Inhibit")) << QStringLiteral("Tessarine") << reason;
}

QDBusMessage ScreenSaverUndo(const QVariant& answer) {
  return ScreenSaverCall(QStringLiteral("UnInhibit")) << answer;
}

/// Desktops differ in which of the two they have and honour, so both are asked.
const std::vector<Service>& Services() {
  static const std::vector<Service> services{
      {PortalRequest, QStringLiteral("o"), PortalUndo},
      {ScreenSaverRequest, QStringLiteral("u"), ScreenSaverUndo},
  };
  return services;
}

}  // namespace

class DBusWakeLock::Requests : public QObject {
 public:
  explicit Requests(std::function<QDBusConnection()> bus) : bus_(std::move(bus)) {}

  void Begin(const QString& reason) {
    ++turn_;
    wanted_ = true;
    for (const Service& service : Services()) {
      Ask(service, reason);
    }
  }

  void End() {
    wanted_ = false;
    for (const QDBusMessage& undo : std::exchange(undos_, {})) {
      bus_().send(undo);
    }
  }

 private:
  void Ask(const Service& service, const QString& reason) {
    auto* watcher = new QDBusPendingCallWatcher(bus_().asyncCall(service.Request(reason)), this);
    connect(watcher, &QDBusPendingCallWatcher::finished, this, [this, watcher, &service, turn = turn_] {
      watcher->deleteLater();
      Take(QDBusPendingReply<>(*watcher).reply(), service, turn);
    });
  }

  void Take(const QDBusMessage& answer, const Service& service, int turn) {
    if (answer.type() != QDBusMessage::ReplyMessage || answer.signature() != service.AnswerSignature) {
      return;  // this desktop has no such service, or it refuses
    }
    const QDBusMessage undo = service.Undo(answer.arguments().constFirst());
    if (wanted_ && turn == turn_) {
      undos_.push_back(undo);
    } else {
      bus_().send(undo);  // the answer came too late
    }
  }

  const std::function<QDBusConnection()> bus_;
  bool wanted_ = false;
  int turn_ = 0;                     ///< counts the times that the computer was to stay awake
  std::vector<QDBusMessage> undos_;  ///< what takes back the promises that were given in this turn
};

DBusWakeLock::DBusWakeLock() : DBusWakeLock(&QDBusConnection::sessionBus) {}

DBusWakeLock::DBusWakeLock(std::function<QDBusConnection()> bus)
    : requests_(std::make_unique<Requests>(std::move(bus))) {}

DBusWakeLock::~DBusWakeLock() = default;

void DBusWakeLock::Hold(const std::string& reason) {
  if (++holds_ == 1) {
    requests_->Begin(QString::fromStdString(reason));
  }
}

void DBusWakeLock::Release() {
  if (--holds_ == 0) {
    requests_->End();
  }
}
