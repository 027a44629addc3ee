#include "ui/Captions.h"

#include <gmock/gmock.h>

#include <QAction>
#include <QDialog>
#include <QGroupBox>
#include <QLabel>
#include <QPushButton>

namespace {

const StringTable English(Language::English);
const StringTable Chinese(Language::SimplifiedChinese);

TEST(Captions, StandWhereEachKindOfControlShowsThem) {
  QDialog window;
  QGroupBox frame;
  QPushButton button;
  QLabel label;
  SetCaptions(English, {{&window, 160}, {&frame, 161}, {&button, 162}, {&label, 113}});
  EXPECT_EQ(window.windowTitle().toStdString(), English.Text(160));
  EXPECT_EQ(frame.title().toStdString(), English.Text(161));
  EXPECT_EQ(button.text().toStdString(), English.Text(162));
  EXPECT_EQ(label.text().toStdString(), English.Text(113));
  EXPECT_NE(label.text(), button.text());
}

TEST(Captions, KeepTheAltLetterOfTheDesignWhereTheTextHasIt) {
  QAction about(QStringLiteral("&About"));
  QAction other(QStringLiteral("E&xit"));
  QAction small(QStringLiteral("&print"));
  SetCaptions(English, {{&about, 218}, {&other, 207}, {&small, 208}});
  EXPECT_EQ(about.text().count(u'&'), 1);
  EXPECT_EQ(about.text().at(about.text().indexOf(u'&') + 1).toLower(), u'a');
  EXPECT_EQ(about.text().remove(u'&').toStdString(), English.Text(218));
  EXPECT_EQ(other.text().toStdString(), English.Text(207)) << "it has no x";
  EXPECT_EQ(small.text().toStdString(), "&" + English.Text(208)) << "in whatever case";
}

TEST(Captions, OfMenusAreWholeWithoutALetter) {
  QAction plain(QStringLiteral("About"));
  QAction chinese(QStringLiteral("&About"));
  QAction broken(QStringLiteral("About&"));
  SetCaptions(English, {{&plain, 218}, {&broken, 218}});
  SetCaptions(Chinese, {{&chinese, 218}});
  EXPECT_EQ(plain.text().toStdString(), English.Text(218));
  EXPECT_EQ(broken.text().toStdString(), English.Text(218));
  EXPECT_EQ(chinese.text().toStdString(), Chinese.Text(218));
}

}  // namespace
