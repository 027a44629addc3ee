#include "members/DatePicker.h"

#include <QAbstractButton>
#include <QAction>
#include <QCalendarWidget>
#include <QDate>
#include <QKeyEvent>
#include <QLocale>
#include <QPainter>
#include <QScreen>
#include <QSignalBlocker>
#include <QVBoxLayout>
#include <algorithm>

#include "platform/qt/QtClock.h"

namespace {

constexpr qsizetype StoredDateLength = 10;

QDate DateOf(const std::string& stored) {
  return QDate::fromString(QString::fromStdString(stored).left(StoredDateLength), Qt::ISODate);
}

QIcon CalendarIcon(const QColor& colour) {
  constexpr int size = 64;
  QPixmap picture(size, size);
  picture.fill(Qt::transparent);
  QPainter painter(&picture);
  painter.setRenderHint(QPainter::Antialiasing);
  painter.setPen(QPen(colour, 5));
  painter.drawRoundedRect(QRect(8, 12, 48, 46), 6, 6);
  painter.fillRect(QRect(8, 16, 48, 12), colour);
  painter.drawLine(20, 4, 20, 16);
  painter.drawLine(44, 4, 44, 16);
  for (int day = 0; day < 6; ++day) {
    painter.fillRect(QRect(17 + day % 3 * 12, 35 + day / 3 * 10, 6, 5), colour);
  }
  return picture;
}

}  // namespace

DatePicker::DatePicker(QWidget* parent) : QLineEdit(parent) {
  setToolTip(QString::fromStdString(ShortDateText(QLocale::system(), QDate::currentDate())));
  QAction* calendar = addAction(CalendarIcon(palette().color(QPalette::Text)), QLineEdit::TrailingPosition);
  connect(calendar, &QAction::triggered, this, &DatePicker::OpenCalendar);
  // textChanged, since textEdited is not emitted when an assistive program enters a text.
  connect(this, &QLineEdit::textChanged, this, &DatePicker::TakeText);
  connect(this, &QLineEdit::editingFinished, this, &DatePicker::Finish);
}

void DatePicker::SetCalendarName(const QString& name) {
  findChild<QAbstractButton*>()->setAccessibleName(name);  // the action's button
}

void DatePicker::SetStored(const std::string& stored) {
  stored_ = stored;
  Finish();
}

void DatePicker::Finish() {
  finished_ = stored_;
  ShowStored();
}

void DatePicker::ShowStored() {
  const QDate date = DateOf(stored_);
  const QSignalBlocker shownOnly(this);
  setText(date.isValid() ? QString::fromStdString(ShortDateText(QLocale::system(), date)) : QString());
}

// While the operator types, the text may be a different date ("1961-02-3") or no date at all; in the latter
// case the last finished date counts.
void DatePicker::TakeText(const QString& text) {
  const QDate date = DateIn(QLocale::system(), text.trimmed());
  if (text.trimmed().isEmpty()) {
    stored_.clear();
  } else if (date.isValid()) {
    TakeDate(date);
  } else {
    stored_ = finished_;
  }
}

void DatePicker::TakeDate(QDate date) {
  stored_ = date.toString(QStringLiteral("yyyy-MM-dd 00:00:00")).toStdString();
}

void DatePicker::keyPressEvent(QKeyEvent* event) {
  if (event->key() == Qt::Key_Down && event->modifiers().testFlag(Qt::AltModifier)) {
    OpenCalendar();
    return;
  }
  QLineEdit::keyPressEvent(event);
}

void DatePicker::focusOutEvent(QFocusEvent* event) {
  QLineEdit::focusOutEvent(event);
  if (event->reason() != Qt::PopupFocusReason) {
    Finish();
  }
}

QPoint DatePicker::PlaceOfCalendar(const QSize& calendar) const {
  const QRect area = screen()->availableGeometry();
  QPoint place = mapToGlobal(QPoint(0, height()));
  if (place.y() + calendar.height() > area.bottom()) {
    place.setY(mapToGlobal(QPoint(0, 0)).y() - calendar.height());
  }
  place.setX(std::min(place.x(), area.right() - calendar.width()));
  return {std::max(place.x(), area.left()), std::max(place.y(), area.top())};
}

void DatePicker::OpenCalendar() {
  auto* popup = new QFrame(this, Qt::Popup);
  popup->setAttribute(Qt::WA_DeleteOnClose);
  auto* calendar = new QCalendarWidget(popup);
  auto* layout = new QVBoxLayout(popup);
  layout->setContentsMargins(0, 0, 0, 0);
  layout->addWidget(calendar);
  if (const QDate date = DateOf(stored_); date.isValid()) {
    calendar->setSelectedDate(date);
  }
  const auto take = [this, popup](QDate date) {
    TakeDate(date);
    Finish();
    popup->close();
  };
  connect(calendar, &QCalendarWidget::clicked, this, take);
  connect(calendar, &QCalendarWidget::activated, this, take);
  popup->adjustSize();
  popup->move(PlaceOfCalendar(popup->size()));
  popup->show();
  popup->move(PlaceOfCalendar(popup->size()));  // some pixels larger now
  calendar->setFocus();
}
