#include "members/DatePicker.h"

#include <gtest/gtest.h>

#include <QAccessible>
#include <QApplication>
#include <QCalendarWidget>
#include <QScreen>
#include <QTest>

#include "platform/qt/QtClock.h"
#include "tests/support/Controls.h"

namespace {

/// A date entry with another control beside it, in the C locale's date format ("12 Apr 1961").
class DateEntry : public testing::Test {
 protected:
  DateEntry() {
    other.move(0, 60);
    ::Show(window);
    picker.setFocus();
  }

  void Enter(const std::string& text) {
    picker.setFocus();
    picker.selectAll();
    QTest::keyClick(&picker, Qt::Key_Delete);
    QTest::keyClicks(&picker, QString::fromStdString(text));
  }

  static std::string TwoDigits(int year) {
    return QString::number(year % 100).rightJustified(2, u'0').toStdString();
  }

  void Leave() { other.setFocus(); }
  std::string Shown() { return picker.text().toStdString(); }

  QCalendarWidget* Calendar() {
    QWidget* popup = QApplication::activePopupWidget();
    return popup == nullptr ? nullptr : popup->findChild<QCalendarWidget*>();
  }

  QWidget window;
  DatePicker picker{&window};
  QLineEdit other{&window};
};

TEST_F(DateEntry, ShowsAStoredDateWithAllDigitsOfTheYear) {
  picker.SetStored("2004-02-29 00:00:00");
  EXPECT_EQ(Shown(), "29 Feb 2004");
  picker.SetStored("1899-12-31 10:20:30");
  EXPECT_EQ(Shown(), "31 Dec 1899");
  EXPECT_EQ(picker.Stored(), "1899-12-31 10:20:30");
}

TEST_F(DateEntry, IsEmptyWithoutADate) {
  picker.SetStored("1961-04-12 00:00:00");
  picker.SetStored("");
  EXPECT_EQ(Shown(), "");
  EXPECT_EQ(picker.Stored(), "");
}

TEST_F(DateEntry, KeepsWhatIsStoredAsItWasWhenNothingIsTyped) {
  for (const char* stored : {"1961-04-12 11:22:33", "no date at all", ""}) {
    picker.SetStored(stored);
    picker.setFocus();
    Leave();
    EXPECT_EQ(picker.Stored(), stored);
  }
}

TEST_F(DateEntry, TakesTheSystemsFormAndYearMonthDay) {
  Enter("12 Apr 1961");
  EXPECT_EQ(picker.Stored(), "1961-04-12 00:00:00");
  Enter("1958-2-28");
  EXPECT_EQ(picker.Stored(), "1958-02-28 00:00:00");
  Enter(" 2010-12-01 ");
  EXPECT_EQ(picker.Stored(), "2010-12-01 00:00:00");
  Leave();
  EXPECT_EQ(Shown(), "1 Dec 2010");
}

TEST_F(DateEntry, TakesADateThatAnAssistiveProgramEnters) {
  picker.SetStored("1961-04-12 10:20:30");
  QAccessibleInterface* accessible = QAccessible::queryAccessibleInterface(&picker);
  ASSERT_NE(accessible, nullptr);
  QAccessibleEditableTextInterface* entry = accessible->editableTextInterface();
  ASSERT_NE(entry, nullptr);
  entry->replaceText(0, static_cast<int>(picker.text().size()), QStringLiteral("1958-02-28"));
  EXPECT_EQ(picker.Stored(), "1958-02-28 00:00:00");
  entry->deleteText(0, static_cast<int>(picker.text().size()));
  EXPECT_EQ(picker.Stored(), "");
}

TEST_F(DateEntry, TakesTwoDigitsOfAYearAs1930To2029) {
  for (const int year : {1930, 1961, 1999, 2000, 2013, 2026, 2029}) {
    Enter("1 Jan " + TwoDigits(year));
    EXPECT_EQ(picker.Stored(), std::to_string(year) + "-01-01 00:00:00");
  }
}

TEST_F(DateEntry, TakesTwoDigitsOfAYearAsTheScoreSheetDoes) {
  for (int year = 1930; year <= 2029; ++year) {
    const std::string text = "1 Jan " + TwoDigits(year);
    Enter(text);
    const QDate date = QDate::fromString(QString::fromStdString(picker.Stored()).left(10), Qt::ISODate);
    EXPECT_EQ(QtClock().LongDate(text), QLocale::system().toString(date, QLocale::LongFormat).toStdString());
  }
}

TEST_F(DateEntry, TakesDatesBefore1970) {
  for (const char* date : {"1969-12-31", "1901-01-01", "1752-09-14"}) {
    Enter(date);
    Leave();
    EXPECT_EQ(picker.Stored(), date + std::string(" 00:00:00"));
  }
}

TEST_F(DateEntry, ReplacesATextThatIsNotADateByTheLastDate) {
  picker.SetStored("1961-04-12 00:00:00");
  for (const char* text : {"yesterday", "1961-02-30", "1961-13-01", "12"}) {
    Enter(text);
    Leave();
    EXPECT_EQ(Shown(), "12 Apr 1961") << text;
    EXPECT_EQ(picker.Stored(), "1961-04-12 00:00:00") << text;
  }
}

TEST_F(DateEntry, IsEmptiedByDeletingItsText) {
  picker.SetStored("1961-04-12 00:00:00");
  Enter("");
  Leave();
  EXPECT_EQ(picker.Stored(), "");
  EXPECT_EQ(Shown(), "");
}

TEST_F(DateEntry, ChoosesInACalendarByTheKeyboard) {
  picker.SetStored("1961-04-12 00:00:00");
  QTest::keyClick(&picker, Qt::Key_Down, Qt::AltModifier);
  QCalendarWidget* calendar = Calendar();
  ASSERT_NE(calendar, nullptr);
  EXPECT_EQ(calendar->selectedDate(), QDate(1961, 4, 12));
  calendar->setSelectedDate(QDate(1961, 5, 20));
  emit calendar->activated(calendar->selectedDate());
  EXPECT_EQ(picker.Stored(), "1961-05-20 00:00:00");
  EXPECT_EQ(Shown(), "20 May 1961");
  EXPECT_EQ(Calendar(), nullptr);
}

TEST_F(DateEntry, OpensTheCalendarInsideTheScreen) {
  const QRect area = window.screen()->availableGeometry();
  window.resize(picker.sizeHint().width(), 100);
  const QPoint last = area.bottomRight() - QPoint(window.width(), window.height());
  for (const QPoint& place : {area.topLeft(), QPoint(last.x(), 0), QPoint(0, last.y()), last}) {
    window.move(place);
    QTest::keyClick(&picker, Qt::Key_Down, Qt::AltModifier);
    ASSERT_NE(Calendar(), nullptr);
    const QRect popup = QApplication::activePopupWidget()->geometry();
    EXPECT_TRUE(area.contains(popup)) << popup.right() << ' ' << popup.bottom();
    QTest::keyClick(Calendar(), Qt::Key_Escape);
  }
}

TEST_F(DateEntry, ClosesTheCalendarByEscapeAndKeepsTheDate) {
  picker.SetStored("1961-04-12 00:00:00");
  QTest::keyClick(&picker, Qt::Key_Down, Qt::AltModifier);
  ASSERT_NE(Calendar(), nullptr);
  QTest::keyClick(QApplication::activePopupWidget(), Qt::Key_Escape);
  EXPECT_EQ(Calendar(), nullptr);
  EXPECT_EQ(picker.Stored(), "1961-04-12 00:00:00");
}

}  // namespace
