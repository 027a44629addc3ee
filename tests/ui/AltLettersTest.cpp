#include "ui/AltLetters.h"

#include <gmock/gmock.h>

#include <QAccessible>
#include <QApplication>
#include <QCheckBox>
#include <QDialog>
#include <QFormLayout>
#include <QLabel>
#include <QLineEdit>
#include <QMainWindow>
#include <QMenuBar>
#include <QPushButton>

#include "tests/support/Controls.h"

namespace {

QString Q(const char* text) {
  return QString::fromUtf8(text);
}

QString NameOf(QWidget& widget) {
  return QAccessible::queryAccessibleInterface(&widget)->text(QAccessible::Name);
}

class AltLettersOf : public testing::Test {
 protected:
  AltLettersOf() { qApp->installEventFilter(&letters); }

  AltLetters letters;
};

/// A dialog with one control of each kind.
struct Form : QDialog {
  explicit Form(const QString& entryCaption, const QString& buttonCaption)
      : Label(entryCaption), Button(buttonCaption), Hidden(buttonCaption) {
    auto* form = new QFormLayout(this);
    form->addRow(&Label, &Entry);
    form->addRow(&Plain);
    form->addRow(&Check);
    form->addRow(&Button);
    form->addRow(&Hidden);
    Label.setBuddy(&Entry);
    Hidden.hide();
  }

  QLabel Label;
  QLineEdit Entry;
  QLabel Plain{Q("Status")};
  QCheckBox Check{Q("Check")};
  QPushButton Button;
  QPushButton Hidden;
};

TEST_F(AltLettersOf, DialogsReachEntriesAndButtons) {
  Form form(Q("Name"), Q("Save"));
  Show(form);
  EXPECT_EQ(form.Label.text(), Q("&Name"));
  EXPECT_EQ(form.Check.text(), Q("&Check"));
  EXPECT_EQ(form.Button.text(), Q("&Save"));
  EXPECT_EQ(form.Plain.text(), Q("Status"));
  EXPECT_EQ(form.Hidden.text(), Q("Save"));
  int presses = 0;
  QObject::connect(&form.Button, &QPushButton::clicked, [&presses] { ++presses; });
  QTest::keyClick(&form, Qt::Key_S, Qt::AltModifier);
  EXPECT_TRUE(QTest::qWaitFor([&presses] { return presses == 1; })) << "the toolkit shows the press first";
  form.Button.setFocus();
  QTest::keyClick(&form, Qt::Key_N, Qt::AltModifier);
  EXPECT_TRUE(form.Entry.hasFocus());
}

TEST_F(AltLettersOf, DialogsReachAButtonThatIsShownLaterInItsPlace) {
  Form form(Q("Name"), Q("Save"));
  QSizePolicy place = form.Hidden.sizePolicy();
  place.setRetainSizeWhenHidden(true);
  form.Hidden.setSizePolicy(place);
  Show(form);
  EXPECT_EQ(form.Hidden.text(), Q("S&ave"));
}

TEST_F(AltLettersOf, CheckBoxesSetThemBeforeTheNextKey) {
  Form form(Q("Name"), Q("Save"));
  Show(form);
  QTest::keyClick(&form, Qt::Key_C, Qt::AltModifier);
  EXPECT_TRUE(form.Check.isChecked());
  EXPECT_TRUE(form.Check.hasFocus());
  QTest::keyClick(&form.Check, Qt::Key_C, Qt::AltModifier);
  EXPECT_FALSE(form.Check.isChecked());
}

TEST_F(AltLettersOf, DialogsLeaveTheNamesForScreenReaders) {
  for (const char* caption : {"Name", "姓名"}) {
    Form form(Q(caption), Q(caption));
    Show(form);
    EXPECT_EQ(form.Button.text().count(u'&'), 1);
    EXPECT_EQ(NameOf(form.Label), Q(caption));
    EXPECT_EQ(NameOf(form.Entry), Q(caption));
    EXPECT_EQ(NameOf(form.Button), Q(caption));
  }
}

TEST_F(AltLettersOf, MainWindowsAreNotThoseOfTheirMenus) {
  QMainWindow window;
  window.menuBar()->addMenu(Q("&Games"));
  window.menuBar()->addMenu(Q("M&embers"));
  QPushButton button(Q("Get"));
  window.setCentralWidget(&button);
  Show(window);
  EXPECT_EQ(button.text(), Q("Ge&t"));
  window.takeCentralWidget();
}

}  // namespace
