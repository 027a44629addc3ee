#pragma once

#include <QDateTime>
#include <QLocale>
#include <QTime>

#include "platform/Clock.h"

/// `date` in the short format of `locale`, but with a four-digit year.
std::string ShortDateText(const QLocale& locale, QDate date);

/// `time` in the short format of `locale`.
std::string ShortTimeText(const QLocale& locale, QTime time);

/// Parses all of `text` as a date, in the short format of `locale` with a two- or four-digit year, or as
/// year-month-day; leading zeros are optional. A two-digit year means 1930 to 2029. Invalid if `text` is not
/// a date.
QDate DateIn(const QLocale& locale, const QString& text);

/// The date at the start of `text`, in the long format of `locale`; `text` unchanged if there is none. Dates
/// are parsed as by DateIn.
std::string LongDateText(const QLocale& locale, const QString& text);

/// The date and the time of day that `text` consists of, as "YYYY-MM-DD HH:MM:SS"; midnight for a date alone.
/// Empty if `text` is anything else. Dates are parsed as by DateIn, times in the short format of `locale`.
std::string StampText(const QLocale& locale, const QString& text);

class QtClock : public Clock {
 public:
  std::string ShortDate() const override { return ShortDateText(QLocale::system(), QDate::currentDate()); }
  std::string ShortTime() const override { return ShortTimeText(QLocale::system(), QTime::currentTime()); }
  std::string Now() const override {
    return QDateTime::currentDateTime().toString(QStringLiteral("yyyy-MM-dd HH:mm:ss")).toStdString();
  }
  std::string LongDate(const std::string& text) const override {
    return LongDateText(QLocale::system(), QString::fromStdString(text));
  }
  std::string Stamp(const std::string& text) const override {
    return StampText(QLocale::system(), QString::fromStdString(text));
  }
};
