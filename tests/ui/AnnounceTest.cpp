#include "ui/Announce.h"

#include <gmock/gmock.h>

#include <QAccessible>
#include <QLabel>
#include <memory>
#include <string>
#include <vector>

#include "tests/support/Announcements.h"

namespace {

using testing::ElementsAre;
using testing::IsEmpty;

/// The notifications of a control, which screen readers say when they appear.
std::vector<std::string> NotificationsOf(const QWidget& control) {
  std::vector<std::string> texts;
  for (QObject* child : control.children()) {
    const QAccessibleInterface* notice = QAccessible::queryAccessibleInterface(child);
    if (notice != nullptr && notice->role() == QAccessible::Notification && !notice->state().invisible) {
      texts.push_back(notice->text(QAccessible::Name).toStdString());
    }
  }
  return texts;
}

TEST(Announced, TextsAreNotificationsForScreenReaders) {
  QLabel status(QStringLiteral("Not saved"));
  status.setObjectName(QStringLiteral("Status"));
  EXPECT_THAT(NotificationsOf(status), IsEmpty());
  const Announcements announced;
  Announce(status);
  EXPECT_THAT(NotificationsOf(status), ElementsAre("Not saved"));
  status.setText(QStringLiteral("Saved"));
  Announce(status);
  EXPECT_THAT(NotificationsOf(status), ElementsAre("Saved"));
  EXPECT_THAT(announced.Heard(), ElementsAre(QStringLiteral("Status"), QStringLiteral("Status")));
}

TEST(Announced, TextsAreThoseThatScreenReadersKnowTheControlBy) {
  QLabel sign(QStringLiteral("\u2713"));
  sign.setAccessibleName(QStringLiteral("Done"));
  Announce(sign);
  EXPECT_THAT(NotificationsOf(sign), ElementsAre("Done"));
}

TEST(Announced, ControlsMayGoAnyTime) {
  Announce(*std::make_unique<QLabel>(QStringLiteral("Not saved")));
  QLabel other(QStringLiteral("Saved"));
  Announce(other);
  EXPECT_THAT(NotificationsOf(other), ElementsAre("Saved"));
}

}  // namespace
