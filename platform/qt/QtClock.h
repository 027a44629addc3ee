#pragma once

#include <QDate>
#include <QLocale>
#include <QTime>

#include "platform/Clock.h"

/// `date` in the short form of `locale`, but with all digits of the year.
std::string ShortDateText(const QLocale& locale, QDate date);

/// `time` in the short form of `locale`.
std::string ShortTimeText(const QLocale& locale, QTime time);

class QtClock : public Clock {
 public:
  std::string ShortDate() const override { return ShortDateText(QLocale::system(), QDate::currentDate()); }
  std::string ShortTime() const override { return ShortTimeText(QLocale::system(), QTime::currentTime()); }
};
