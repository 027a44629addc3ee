#include "ui/Announce.h"

#include <QAccessible>
#include <QAccessibleObject>
#include <QCoreApplication>
#include <QWidget>

namespace {

/// A child of an announced control, for what screen readers get to know of the announcement.
class Notice : public QObject {
 public:
  using QObject::QObject;
};

/// Screen readers say a notification that appears. The toolkit has an event of its own for that, but this
/// platform's bridge to screen readers drops it.
class NoticeInterface : public QAccessibleObject {
 public:
  using QAccessibleObject::QAccessibleObject;

  QAccessible::Role role() const override { return QAccessible::Notification; }
  QAccessible::State state() const override { return {}; }
  QString text(QAccessible::Text kind) const override {
    return kind == QAccessible::Name ? parent()->text(QAccessible::Name) : QString();
  }
  QAccessibleInterface* parent() const override {
    return QAccessible::queryAccessibleInterface(object()->parent());
  }
  QAccessibleInterface* child(int /*index*/) const override { return nullptr; }
  int childCount() const override { return 0; }
  int indexOfChild(const QAccessibleInterface* /*child*/) const override { return -1; }
};

Notice& NoticeOf(QWidget& control) {
  for (QObject* child : control.children()) {
    if (auto* notice = dynamic_cast<Notice*>(child)) {
      return *notice;
    }
  }
  auto* notice = new Notice(&control);
  QAccessible::registerAccessibleInterface(new NoticeInterface(notice));
  return *notice;
}

}  // namespace

void Announce(QWidget& control) {
  // Screen readers remember the name that a notification had before.
  for (const QAccessible::Event what : {QAccessible::NameChanged, QAccessible::ObjectShow}) {
    QAccessibleEvent event(&NoticeOf(control), what);
    QAccessible::updateAccessibility(&event);
  }
  AnnouncedEvent announced;
  QCoreApplication::sendEvent(&control, &announced);
}
