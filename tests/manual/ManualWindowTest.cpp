#include "manual/ManualWindow.h"

#include <gtest/gtest.h>

#include <QDialog>
#include <QLineEdit>
#include <QListWidget>
#include <QScrollBar>
#include <QTextBlock>
#include <QTextBrowser>
#include <QVBoxLayout>
#include <QWindow>

#include "manual/ManualKey.h"
#include "tests/support/CaredFor.h"
#include "tests/support/Controls.h"

namespace {

QString Q(const char* text) {
  return QString::fromUtf8(text);
}

QList<QPixmap> PicturesOf(const QTextDocument& document) {
  QList<QPixmap> pictures;
  for (QTextBlock block = document.begin(); block.isValid(); block = block.next()) {
    for (auto part = block.begin(); !part.atEnd(); ++part) {
      const QTextCharFormat format = part.fragment().charFormat();
      if (format.isImageFormat()) {
        pictures.append(document.resource(QTextDocument::ImageResource, QUrl(format.toImageFormat().name()))
                            .value<QPixmap>());
      }
    }
  }
  return pictures;
}

/// A window of the program with one entry.
template <typename Window>
struct Other : Window {
  explicit Other(const char* name, QWidget* parent = nullptr) : Window(parent) {
    this->setObjectName(Q(name));
    (new QVBoxLayout(this))->addWidget(&Entry);
  }
  QLineEdit Entry;
};

class ManualOf : public testing::Test {
 protected:
  ManualOf() { Show(main); }

  ManualWindow* Window() const {
    for (QWidget* widget : QApplication::topLevelWidgets()) {
      if (auto* window = qobject_cast<ManualWindow*>(widget)) {
        return window;
      }
    }
    return nullptr;
  }

  std::string Title() const {
    return Find<QListWidget>(*Window(), "Pages").currentItem()->text().toStdString();
  }

  bool IsBlocked() const {
    QCoreApplication::processEvents();
    const QWidget* modal = QApplication::activeModalWidget();
    return modal != nullptr && Window()->windowHandle()->transientParent() != modal->windowHandle();
  }

  StringTable strings{Language::English};
  Other<QWidget> main{"frmRx"};
  ManualKey key{strings, Q(TESSARINE_MANUAL), main};
};

TEST_F(ManualOf, OpensAtTheWindowInFront) {
  QTest::keyClick(&main.Entry, Qt::Key_F1);
  ASSERT_NE(Window(), nullptr);
  EXPECT_TRUE(Window()->isVisible());
  EXPECT_EQ(Title(), "An evening with Tessarine");
  EXPECT_TRUE(Find<QTextBrowser>(*Window(), "Page").toPlainText().startsWith(Q("An evening with Tessarine")));
  Other<QDialog> members("Members", &main);
  members.setModal(true);
  Show(members);
  QTest::keyClick(&members.Entry, Qt::Key_F1);
  EXPECT_EQ(Title(), "Members");
}

TEST_F(ManualOf, OpensForABoxAtThePageOfItsWindow) {
  Other<QDialog> missions("Scenarios", &main);
  Other<QDialog> box("", &missions);
  box.setModal(true);
  Show(missions);
  Show(box);
  QTest::keyClick(&box.Entry, Qt::Key_F1);
  EXPECT_EQ(Title(), "Missions");
}

TEST_F(ManualOf, CanBeReadWhileOtherWindowsMustBeAnswered) {
  QTest::keyClick(&main.Entry, Qt::Key_F1);
  EXPECT_FALSE(IsBlocked());
  {
    Other<QDialog> members("Members", &main);
    members.setModal(true);
    Show(members);
    EXPECT_FALSE(IsBlocked());
    {
      Other<QDialog> box("", &members);
      box.setModal(true);
      Show(box);
      EXPECT_FALSE(IsBlocked());
    }
    EXPECT_FALSE(IsBlocked());
    Window()->activateWindow();
    QListWidget& pages = Find<QListWidget>(*Window(), "Pages");
    // By way of the window itself, which is where a blocked one loses its clicks.
    QTest::mouseClick(Window()->windowHandle(), Qt::LeftButton, {},
                      pages.viewport()->mapTo(Window(), pages.visualItemRect(pages.item(1)).center()));
    EXPECT_EQ(Title(), pages.item(1)->text().toStdString());
  }
  QCoreApplication::processEvents();
  EXPECT_TRUE(Window()->isVisible());
}

TEST_F(ManualOf, IsClosedByEscapeAndOpensAgain) {
  key.Open();
  QTest::keyClick(&Find<QTextBrowser>(*Window(), "Page"), Qt::Key_Escape);
  EXPECT_FALSE(Window()->isVisible());
  main.activateWindow();
  ASSERT_TRUE(QTest::qWaitForWindowActive(&main));
  QTest::keyClick(&main.Entry, Qt::Key_F1);
  EXPECT_TRUE(Window()->isVisible());
}

TEST_F(ManualOf, ShowsThePicturesOfEachPageWithinItsWidth) {
  for (const Language language : {Language::English, Language::SimplifiedChinese}) {
    const StringTable texts(language);
    ManualWindow window(texts, Q(TESSARINE_MANUAL));
    window.ShowPageOf(main);
    QTextBrowser& page = Find<QTextBrowser>(window, "Page");
    QListWidget& pages = Find<QListWidget>(window, "Pages");
    int shown = 0;
    for (int row = 0; row < pages.count(); ++row) {
      pages.setCurrentRow(row);
      for (const QPixmap& picture : PicturesOf(*page.document())) {
        EXPECT_FALSE(picture.isNull()) << pages.item(row)->text().toStdString();
        EXPECT_LE(picture.deviceIndependentSize().width(), page.viewport()->width());
        ++shown;
      }
    }
    EXPECT_GE(shown, 20);
  }
}

TEST_F(ManualOf, KeepsThePicturesWithinANarrowerWindow) {
  key.Open();
  QTextBrowser& page = Find<QTextBrowser>(*Window(), "Page");
  const auto width = [&page] { return PicturesOf(*page.document()).front().deviceIndependentSize().width(); };
  constexpr double large = 400;
  ASSERT_TRUE(QTest::qWaitFor([&] { return width() > large; }));
  const double before = width();
  Window()->resize(560, 500);
  ASSERT_TRUE(QTest::qWaitFor([&] { return width() < before; }));
  EXPECT_LE(width(), page.viewport()->width());
  EXPECT_FALSE(page.horizontalScrollBar()->isVisible());
}

TEST_F(ManualOf, FollowsALinkToAnotherPage) {
  Other<QDialog> board("PlayerDetails", &main);
  Show(board);
  QTest::keyClick(&board.Entry, Qt::Key_F1);
  QTextBrowser& page = Find<QTextBrowser>(*Window(), "Page");
  emit page.anchorClicked(QUrl(Q("#score-sheets")));
  EXPECT_EQ(Title(), "Score sheets");
  EXPECT_TRUE(page.toPlainText().startsWith(Q("Score sheets")));
  emit page.anchorClicked(QUrl(Q("#no-such-page")));
  EXPECT_EQ(Title(), "Score sheets");
}

TEST_F(ManualOf, IsInTheLanguageOfTheProgram) {
  const StringTable texts(Language::SimplifiedChinese);
  ManualWindow window(texts, Q(TESSARINE_MANUAL));
  Other<QDialog> members("Members", &main);
  window.ShowPageOf(members);
  EXPECT_EQ(window.windowTitle(), Q("手册"));
  EXPECT_EQ(Find<QListWidget>(window, "Pages").currentItem()->text(), Q("会员"));
  EXPECT_TRUE(Find<QTextBrowser>(window, "Page").toPlainText().startsWith(Q("会员\n")));
  emit Find<QTextBrowser>(window, "Page").anchorClicked(QUrl(Q("#成绩单")));
  EXPECT_EQ(Find<QListWidget>(window, "Pages").currentItem()->text(), Q("成绩单"));
}

// What fits on A4 and on Letter, with margins of a centimetre, in letters of 10 points.
TEST_F(ManualOf, HasTheFirstEveningOnOneSheetOfPaper) {
  constexpr double pixelsInACentimetre = 96 / 2.54;
  constexpr QSizeF sheet(19.0 * pixelsInACentimetre, 25.9 * pixelsInACentimetre);
  for (const Language language : {Language::English, Language::SimplifiedChinese}) {
    const StringTable texts(language);
    ManualWindow window(texts, Q(TESSARINE_MANUAL));
    window.ShowPageOf(main);
    Find<QListWidget>(window, "Pages").setCurrentRow(0);
    const std::unique_ptr<QTextDocument> page(Find<QTextBrowser>(window, "Page").document()->clone());
    QFont letters = page->defaultFont();
    letters.setPointSize(10);
    page->setDefaultFont(letters);
    page->setPageSize(sheet);
    EXPECT_GT(page->characterCount(), 500);
    EXPECT_EQ(page->pageCount(), 1);
  }
}

TEST_F(ManualOf, IsCaredFor) {
  key.Open();
  ExpectCaredFor(*Window());
}

}  // namespace
