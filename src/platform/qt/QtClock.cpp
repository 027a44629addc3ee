#include "platform/qt/QtClock.h"

namespace {

QString ShortFormatWithFullYear(const QLocale& locale) {
  QString format = locale.dateFormat(QLocale::ShortFormat);
  if (!format.contains(QStringLiteral("yyyy"))) {
    format.replace(QStringLiteral("yy"), QStringLiteral("yyyy"));
  }
  return format;
}

/// The date that `text` is as a whole.
QDate DateIn(const QLocale& locale, const QString& text) {
  for (const QString& format : {ShortFormatWithFullYear(locale), locale.dateFormat(QLocale::ShortFormat),
                                QStringLiteral("yyyy-MM-dd")}) {
    if (const QDate date = locale.toDate(text, format); date.isValid()) {
      return date;
    }
  }
  return {};
}

}  // namespace

std::string ShortDateText(const QLocale& locale, QDate date) {
  return locale.toString(date, ShortFormatWithFullYear(locale)).toStdString();
}

std::string ShortTimeText(const QLocale& locale, QTime time) {
  return locale.toString(time, QLocale::ShortFormat).toStdString();
}

std::string LongDateText(const QLocale& locale, const QString& text) {
  // The date may have blanks of its own, and so may the time: the longest text that is a date counts.
  const QString trimmed = text.trimmed();
  for (auto end = trimmed.size(); end > 0; end = trimmed.lastIndexOf(u' ', end - 1)) {
    if (const QDate date = DateIn(locale, trimmed.left(end)); date.isValid()) {
      return locale.toString(date, QLocale::LongFormat).toStdString();
    }
  }
  return text.toStdString();
}
