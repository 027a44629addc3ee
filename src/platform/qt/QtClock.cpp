#include "platform/qt/QtClock.h"

namespace {

QString ShortFormatWithFullYear(const QLocale& locale) {
  QString format = locale.dateFormat(QLocale::ShortFormat);
  if (!format.contains(QStringLiteral("yyyy"))) {
    format.replace(QStringLiteral("yy"), QStringLiteral("yyyy"));
  }
  return format;
}

/// The format changed to accept one-digit days and months without a leading zero.
QString Lenient(QString form) {
  form.replace(QStringLiteral("dd"), QStringLiteral("d"));
  if (!form.contains(QStringLiteral("MMM"))) {
    form.replace(QStringLiteral("MM"), QStringLiteral("M"));
  }
  return form;
}

/// Two-digit years mean 1930 to 2029.
constexpr int EarliestYear = 1930;

}  // namespace

QDate DateIn(const QLocale& locale, const QString& text) {
  const QString longForm = Lenient(ShortFormatWithFullYear(locale));
  for (const QString& form : {longForm, QStringLiteral("yyyy-M-d")}) {
    if (const QDate date = locale.toDate(text, form); date.isValid()) {
      return date;
    }
  }
  QString shortForm = longForm;
  shortForm.replace(QStringLiteral("yyyy"), QStringLiteral("yy"));
  const QDate date = locale.toDate(text, shortForm);  // in the 1900s
  if (!date.isValid()) {
    // The year 2000 has a 29 February, 1900 had none.
    return locale.toDate(QString(text).replace(QStringLiteral("00"), QStringLiteral("2000")), longForm);
  }
  constexpr int century = 100;
  return date.year() < EarliestYear ? date.addYears(century) : date;
}

std::string ShortDateText(const QLocale& locale, QDate date) {
  return locale.toString(date, ShortFormatWithFullYear(locale)).toStdString();
}

std::string ShortTimeText(const QLocale& locale, QTime time) {
  return locale.toString(time, QLocale::ShortFormat).toStdString();
}

std::string LongDateText(const QLocale& locale, const QString& text) {
  // Both the date and the time may contain spaces, so the longest prefix that is a date counts.
  const QString trimmed = text.trimmed();
  for (auto end = trimmed.size(); end > 0; end = trimmed.lastIndexOf(u' ', end - 1)) {
    if (const QDate date = DateIn(locale, trimmed.left(end)); date.isValid()) {
      return locale.toString(date, QLocale::LongFormat).toStdString();
    }
  }
  return text.toStdString();
}

std::string StampText(const QLocale& locale, const QString& text) {
  const QString trimmed = text.trimmed();
  for (auto end = trimmed.size(); end > 0; end = trimmed.lastIndexOf(u' ', end - 1)) {
    const QDate date = DateIn(locale, trimmed.left(end));
    const QString rest = trimmed.mid(end).trimmed();
    const QTime time = rest.isEmpty() ? QTime(0, 0) : locale.toTime(rest, QLocale::ShortFormat);
    if (date.isValid() && time.isValid()) {
      return QDateTime(date, time).toString(QStringLiteral("yyyy-MM-dd HH:mm:ss")).toStdString();
    }
  }
  return {};
}
