#include "platform/qt/QtClock.h"

#include <gtest/gtest.h>

namespace {

const QDate Date(2013, 5, 9);
const QTime Afternoon(14, 30, 5);

TEST(ShortDateText, IsTheLocalesFormWithAllDigitsOfTheYear) {
  EXPECT_EQ(ShortDateText(QLocale(QLocale::English, QLocale::UnitedStates), Date), "5/9/2013");
  EXPECT_EQ(ShortDateText(QLocale(QLocale::German, QLocale::Germany), Date), "09.05.2013");
  EXPECT_EQ(ShortDateText(QLocale(QLocale::English, QLocale::Australia), Date), "9/5/2013");
  EXPECT_EQ(ShortDateText(QLocale(QLocale::Chinese, QLocale::China), Date), "2013/5/9");
  EXPECT_EQ(ShortDateText(QLocale::c(), Date), "9 May 2013");
}

TEST(ShortDateText, ShowsTheYearInEveryLocaleWithWesternDigits) {
  int checked = 0;
  for (const QLocale& locale :
       QLocale::matchingLocales(QLocale::AnyLanguage, QLocale::AnyScript, QLocale::AnyTerritory)) {
    if (locale.zeroDigit() == QStringLiteral("0")) {
      const std::string text = ShortDateText(locale, Date);
      EXPECT_NE(text.find("2013"), std::string::npos) << locale.name().toStdString() << ": " << text;
      EXPECT_EQ(text.find("20132013"), std::string::npos) << locale.name().toStdString() << ": " << text;
      ++checked;
    }
  }
  EXPECT_GT(checked, 100);
}

TEST(ShortTimeText, IsTheLocalesForm) {
  EXPECT_EQ(ShortTimeText(QLocale(QLocale::English, QLocale::UnitedStates), Afternoon), "2:30 PM");
  EXPECT_EQ(ShortTimeText(QLocale(QLocale::German, QLocale::Germany), Afternoon), "14:30");
  EXPECT_EQ(ShortTimeText(QLocale(QLocale::Chinese, QLocale::China), Afternoon), "14:30");
  EXPECT_EQ(ShortTimeText(QLocale::c(), Afternoon), "14:30:05");
}

TEST(LongDateText, IsTheLocalesFormOfAShortDateWithOrWithoutATime) {
  const QLocale american(QLocale::English, QLocale::UnitedStates);
  EXPECT_EQ(LongDateText(american, QStringLiteral("5/9/2013 2:30 PM")), "Thursday, May 9, 2013");
  EXPECT_EQ(LongDateText(american, QStringLiteral(" 5/9/2013")), "Thursday, May 9, 2013");
  EXPECT_EQ(LongDateText(american, QStringLiteral("2013-05-09 14:30")), "Thursday, May 9, 2013");
  EXPECT_EQ(LongDateText(QLocale(QLocale::German, QLocale::Germany), QStringLiteral("09.05.2013 14:30")),
            "Donnerstag, 9. Mai 2013");
  EXPECT_EQ(LongDateText(QLocale(QLocale::Chinese, QLocale::China), QStringLiteral("2013/5/9 14:30")),
            "2013年5月9日星期四");
  EXPECT_EQ(LongDateText(QLocale::c(), QStringLiteral("9 May 2013 14:30:05")), "Thursday, 9 May 2013");
}

TEST(LongDateText, TakesTwoDigitsOfAYearAs1930To2029) {
  const QLocale american(QLocale::English, QLocale::UnitedStates);
  EXPECT_EQ(LongDateText(american, QStringLiteral("5/9/13 2:30 PM")), "Thursday, May 9, 2013");
  EXPECT_EQ(LongDateText(american, QStringLiteral("1/1/30")), "Wednesday, January 1, 1930");
  EXPECT_EQ(LongDateText(american, QStringLiteral("12/31/29")), "Monday, December 31, 2029");
  EXPECT_EQ(LongDateText(american, QStringLiteral("2/29/00")), "Tuesday, February 29, 2000");
  EXPECT_EQ(LongDateText(american, QStringLiteral("2/30/00")), "2/30/00");
}

TEST(LongDateText, IsTheTextItselfWhenItIsNoDate) {
  for (const char* text : {"", "N/A", "today", "31/31/2013 14:30", " 14:30 "}) {
    EXPECT_EQ(LongDateText(QLocale(QLocale::English, QLocale::UnitedStates), QString::fromUtf8(text)), text);
  }
}

TEST(LongDateText, ReadsWhatTheClockWritesInEveryLocaleWithWesternDigits) {
  int checked = 0;
  for (const QLocale& locale :
       QLocale::matchingLocales(QLocale::AnyLanguage, QLocale::AnyScript, QLocale::AnyTerritory)) {
    if (locale.zeroDigit() == QStringLiteral("0")) {
      const std::string text = ShortDateText(locale, Date) + ' ' + ShortTimeText(locale, Afternoon);
      EXPECT_EQ(LongDateText(locale, QString::fromStdString(text)),
                locale.toString(Date, QLocale::LongFormat).toStdString())
          << locale.name().toStdString() << ": " << text;
      ++checked;
    }
  }
  EXPECT_GT(checked, 100);
}

TEST(QtClock, TellsThePresentLocalTimeInTheSystemsForm) {
  const QtClock clock;
  std::string before;
  std::string told;
  std::string after;
  do {
    before = ShortDateText(QLocale::system(), QDate::currentDate()) + ' ' +
             ShortTimeText(QLocale::system(), QTime::currentTime());
    told = clock.ShortDate() + ' ' + clock.ShortTime();
    after = ShortDateText(QLocale::system(), QDate::currentDate()) + ' ' +
            ShortTimeText(QLocale::system(), QTime::currentTime());
  } while (before != after);
  EXPECT_EQ(told, before);
}

TEST(QtClock, TellsDateAndTimeAsTheDatabasesKeepThem) {
  const QDateTime before = QDateTime::currentDateTime().addSecs(-1);
  const QString now = QString::fromStdString(QtClock().Now());
  const QDateTime read = QDateTime::fromString(now, QStringLiteral("yyyy-MM-dd HH:mm:ss"));
  EXPECT_TRUE(read.isValid()) << now.toStdString();
  EXPECT_GE(read, before);
  EXPECT_LE(read, QDateTime::currentDateTime());
}

}  // namespace
