#include "platform/qt/QtClock.h"

std::string ShortDateText(const QLocale& locale, QDate date) {
  QString format = locale.dateFormat(QLocale::ShortFormat);
  if (!format.contains(QStringLiteral("yyyy"))) {
    format.replace(QStringLiteral("yy"), QStringLiteral("yyyy"));
  }
  return locale.toString(date, format).toStdString();
}

std::string ShortTimeText(const QLocale& locale, QTime time) {
  return locale.toString(time, QLocale::ShortFormat).toStdString();
}
