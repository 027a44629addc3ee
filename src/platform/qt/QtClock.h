#pragma once

#include <QDateTime>
#include <QLocale>
#include <QTime>

#include "platform/Clock.h"

/// `date` in the short form of `locale`, but with all digits of the year.
std::string ShortDateText(const QLocale& locale, QDate date);

/// `time` in the short form of `locale`.
std::string ShortTimeText(const QLocale& locale, QTime time);

/// The date that `text` is as a whole, invalid for none: in the short form of `locale`, with two or four
/// digits of the year, or year-month-day; zeros in front may be missing. Two digits of a year make a date of
/// the hundred years from `earliest` on.
QDate DateIn(const QLocale& locale, const QString& text, QDate earliest);

/// The date at the start of `text`, in the long form of `locale`; `text` as it stands when there is none.
/// Dates are read as DateIn reads them; two digits of a year mean 1930 to 2029.
std::string LongDateText(const QLocale& locale, const QString& text);

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
};
