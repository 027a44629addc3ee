#include "ui/WorkArea.h"

#include <gtest/gtest.h>

#include <QDialog>
#include <QHBoxLayout>
#include <QLabel>
#include <QLineEdit>
#include <QMainWindow>
#include <QMessageBox>
#include <QPushButton>

#include "tests/support/CaredFor.h"
#include "tests/support/Controls.h"
#include "tests/support/OnScreen.h"

namespace {

/// A dialog on the primary screen, 1280 x 1024: entries one below the other, and a row of buttons.
class AForm : public QDialog {
 public:
  explicit AForm(int entries, QWidget* parent = nullptr) : QDialog(parent) {
    auto* column = new QVBoxLayout(this);
    for (int i = 0; i < entries; ++i) {
      Entries.push_back(new QLineEdit(this));
      Entries.back()->setObjectName(QStringLiteral("Entry%1").arg(i));
      column->addWidget(Entries.back());
    }
    auto* row = new QHBoxLayout;
    for (const char* name : {"OK", "Cancel"}) {
      auto* button = new QPushButton(QString::fromLatin1(name), this);
      button->setObjectName(button->text());
      row->addWidget(button);
    }
    column->addLayout(row);
  }

  std::vector<QLineEdit*> Entries;
};

constexpr int TooMany = 60;  ///< entries for a screen of 1024 pixels

TEST(WorkArea, LeavesADialogThatFitsAsItIs) {
  AForm form(5);
  form.resize(500, 400);
  Show(form);
  EXPECT_EQ(form.size(), QSize(500, 400));
  EXPECT_EQ(ScrolledPart(form), nullptr);
}

TEST(WorkArea, MakesALargeDialogSmallerWithoutScrollingWhileItsContentsFit) {
  AForm form(5);
  form.resize(2000, 1500);
  Show(form);
  ExpectInWorkArea(form);
  EXPECT_EQ(ScrolledPart(form), nullptr);
}

TEST(WorkArea, LetsWhatDoesNotFitScrollBesideTheButtons) {
  AForm form(TooMany);
  Show(form);
  ExpectInWorkArea(form);
  ExpectButtonsReachable(form);
  ASSERT_NE(ScrolledPart(form), nullptr);
  EXPECT_TRUE(form.Entries.back()->visibleRegion().isEmpty());
  ::Press(form, "OK");  // in view without scrolling
  EXPECT_FALSE(Find<QPushButton>(form, "Cancel").visibleRegion().isEmpty());
}

TEST(WorkArea, FollowsTheFocusThroughWhatScrolls) {
  AForm form(TooMany);
  form.Entries[1]->setFocus();
  Show(form);
  EXPECT_TRUE(form.Entries[1]->hasFocus());
  for (int i = 1; i < TooMany - 1; ++i) {
    Type(form, Qt::Key_Tab);
  }
  EXPECT_TRUE(form.Entries.back()->hasFocus());
  EXPECT_FALSE(form.Entries.back()->visibleRegion().isEmpty());
  Type(form, Qt::Key_Tab);
  EXPECT_TRUE(Find<QPushButton>(form, "OK").hasFocus());
}

TEST(WorkArea, IsThatOfTheParentsScreen) {
  QWidget parent;
  parent.setScreen(&ScreenNamed("scaled by 2"));
  parent.move(ScreenNamed("scaled by 2").geometry().topLeft());
  Show(parent);
  AForm form(18, &parent);  // fits on the primary screen
  Show(form);
  EXPECT_EQ(form.screen(), &ScreenNamed("scaled by 2"));
  ExpectInWorkArea(form);
  ExpectButtonsReachable(form);
}

TEST(WorkArea, LetsTheMainWindowScrollBelowItsMenuBar) {
  QMainWindow window;
  auto* central = new QLabel(QStringLiteral("Scores"));
  central->setMinimumSize(3000, 3000);
  window.setCentralWidget(central);
  window.resize(800, 600);
  Show(window);
  EXPECT_EQ(window.size(), QSize(800, 600));
  EXPECT_EQ(central->size(), QSize(3000, 3000));
}

TEST(WorkArea, KeepsTheTitleOfAShortBoxWhole) {
  const QString title = QStringLiteral("Screen Resolution Warning");
  QMessageBox box;
  box.setText(QStringLiteral("No."));
  box.setWindowTitle(title);
  Show(box);
  QFont bold = box.font();
  bold.setBold(true);
  const int buttonsOfTheFrame = 90;
  EXPECT_GE(box.width(), QFontMetrics(bold).horizontalAdvance(title) + buttonsOfTheFrame);
  AForm form(1);
  form.setWindowTitle(title);
  Show(form);
  EXPECT_GE(form.width(), QFontMetrics(bold).horizontalAdvance(title) + buttonsOfTheFrame);
}

}  // namespace
