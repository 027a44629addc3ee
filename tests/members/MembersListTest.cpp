#include <QAccessible>

#include "members/MemberDelegate.h"
#include "members/MemberListModel.h"
#include "members/MemberListView.h"
#include "tests/members/MembersWindow.h"
#include "tests/members/Pictures.h"
#include "tests/support/Contrast.h"

namespace {

using testing::ElementsAre;
using testing::IsEmpty;
using testing::SizeIs;

/// The list beside the form.
class MembersList : public MembersWindow {
 protected:
  MemberListView& List() { return ::Find<MemberListView>(*window, "MemberHits"); }
  const QAbstractItemModel& Rows() { return *List().model(); }

  std::vector<std::string> Listed() {
    std::vector<std::string> names;
    for (int row = 0; row < Rows().rowCount(); ++row) {
      names.push_back(Cell(row, Qt::DisplayRole));
    }
    return names;
  }
  std::string Cell(int row, int role) { return Rows().index(row, 0).data(role).toString().toStdString(); }

  /// Name of the selected member, empty if there is none.
  std::string Selected() {
    const QModelIndexList selected = List().selectionModel()->selectedIndexes();
    return selected.isEmpty() ? "" : selected.first().data().toString().toStdString();
  }

  /// Types into the search box and waits until the list has this many rows.
  bool TypeUntil(const std::string& text, int rows) {
    Enter("SearchText", text);
    return QTest::qWaitFor([&] { return Rows().rowCount() == rows; });
  }

  void Click(int row) {
    QTest::mouseClick(List().viewport(), Qt::LeftButton, {},
                      List().visualRect(Rows().index(row, 0)).center());
  }
  void DoubleClick(int row) {
    const QPoint at = List().visualRect(Rows().index(row, 0)).center();
    QTest::mouseClick(List().viewport(), Qt::LeftButton, {}, at);
    QTest::mouseDClick(List().viewport(), Qt::LeftButton, {}, at);
  }
};

TEST_F(MembersList, ShowsAllMembersAtFirstAndSelectsTheOneInTheForm) {
  Open([this] {
    EXPECT_THAT(Listed(), ElementsAre("Rhys Morgan", "Alice Belmont", "Sean O'Brien", "小明 王"));
    EXPECT_EQ(Selected(), "Rhys Morgan");
    Press("DataNext");
    EXPECT_EQ(Selected(), "Alice Belmont");
    EXPECT_EQ(Text("SearchText"), "");
  });
}

TEST_F(MembersList, FollowsTheTypingAndLeavesTheFormAlone) {
  Open([this] {
    Press("DataNext");
    Line("CityEntry").setText(QStringLiteral("Ely"));
    ASSERT_TRUE(TypeUntil("sh", 1));
    EXPECT_THAT(Listed(), ElementsAre("Sean O'Brien"));
    EXPECT_EQ(Selected(), "");
    EXPECT_EQ(Text("LastNameEntry"), "Belmont");
    EXPECT_EQ(Text("CityEntry"), "Ely");
    EXPECT_EQ(Shown("DataPlace"), "2 / 4");
    EXPECT_EQ(Stored("City", 2), "NULL");
    ASSERT_TRUE(TypeUntil("m", 2));
    EXPECT_EQ(Selected(), "Alice Belmont");
    EXPECT_EQ(Shown("DataPlace"), "2 / 4");
    EXPECT_EQ(Text("CityEntry"), "Ely");
    EXPECT_EQ(Stored("City", 2), "NULL");
  });
}

TEST_F(MembersList, TakesAnApostropheAsALetterAndShowsNoBox) {
  Open([this] {
    ASSERT_TRUE(TypeUntil("O'B", 1));
    EXPECT_THAT(Listed(), ElementsAre("Sean O'Brien"));
    ASSERT_TRUE(TypeUntil("[a", 0));
    Line("SearchText").clear();
    ASSERT_TRUE(QTest::qWaitFor([this] { return Rows().rowCount() == 4; }));
  });
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
}

TEST_F(MembersList, FollowsAtOnceWhenTheSearchIsStarted) {
  Open([this] {
    Enter("SearchText", "sh");
    Type(*window, Qt::Key_Return);
    EXPECT_THAT(Listed(), ElementsAre("Sean O'Brien"));
    Enter("SearchText", "mole");
    Press("Search");
    EXPECT_THAT(Listed(), ElementsAre("Alice Belmont"));
    EXPECT_EQ(Selected(), "Alice Belmont");
  });
}

TEST_F(MembersList, IsEnteredByTheDownKeyAfterTheSearch) {
  Open([this] {
    Enter("SearchText", "mo");
    Type(*window, Qt::Key_Down);  // before the pause
    EXPECT_TRUE(List().hasFocus());
    EXPECT_THAT(Listed(), ElementsAre("Rhys Morgan", "Alice Belmont"));
    EXPECT_EQ(Shown("DataPlace"), "1 / 2");
    EXPECT_EQ(Selected(), "Rhys Morgan");
    Type(*window, Qt::Key_Down);
    EXPECT_EQ(Text("LastNameEntry"), "Belmont");
    EXPECT_EQ(Shown("DataPlace"), "2 / 2");
    Type(*window, Qt::Key_Up);
    EXPECT_EQ(Text("LastNameEntry"), "Morgan");
  });
}

TEST_F(MembersList, IsNotEnteredWithoutAHit) {
  Open([this] {
    ASSERT_TRUE(TypeUntil("nobody", 0));
    Type(*window, Qt::Key_Down);
    EXPECT_TRUE(Line("SearchText").hasFocus());
    EXPECT_EQ(Shown("DataPlace"), "1 / 4");
  });
}

TEST_F(MembersList, IsNotEnteredWithoutAHitBeforeThePauseEither) {
  Open([this] {
    Enter("SearchText", "nobody");
    Type(*window, Qt::Key_Down);
    EXPECT_TRUE(Line("SearchText").hasFocus());
    EXPECT_THAT(Listed(), IsEmpty());
    EXPECT_EQ(Shown("DataPlace"), "1 / 4");
  });
}

TEST_F(MembersList, ShowsInTheFormAMemberWhomTheSearchDidNotFind) {
  Open([this] {
    SearchFor("mole");
    EXPECT_EQ(Shown("DataPlace"), "1 / 1");
    ASSERT_TRUE(TypeUntil("O'B", 1));
    Type(*window, Qt::Key_Down);
    EXPECT_EQ(Text("LastNameEntry"), "O'Brien");
    EXPECT_EQ(Selected(), "Sean O'Brien");
    QApplication::processEvents();
  });
  ASSERT_THAT(venue.Boxes.Boxes, SizeIs(1));  // of the search that runs when its box is left
  EXPECT_THAT(venue.Boxes.Boxes[0].Text, testing::StartsWith("Run-time error '3075': "));
}

TEST_F(MembersList, ChoosesByReturn) {
  Open([this] {
    ASSERT_TRUE(TypeUntil("m", 2));
    Type(*window, Qt::Key_Down);
    Type(*window, Qt::Key_Down);
    Type(*window, Qt::Key_Return);
    EXPECT_FALSE(window->isVisible());
    EXPECT_EQ(window->SelectedContact(), "2");
  });
}

TEST_F(MembersList, ChoosesByADoubleClick) {
  Open([this] {
    DoubleClick(2);
    EXPECT_FALSE(window->isVisible());
    EXPECT_EQ(window->SelectedContact(), "5");
  });
}

TEST_F(MembersList, ChoosesNobodyByADoubleClickOfAnotherButton) {
  Open([this] {
    const QPoint at = List().visualRect(Rows().index(2, 0)).center();
    for (const Qt::MouseButton button : {Qt::RightButton, Qt::MiddleButton}) {
      QTest::mouseClick(List().viewport(), button, {}, at);
      QTest::mouseDClick(List().viewport(), button, {}, at);
    }
    EXPECT_TRUE(window->isVisible());
    EXPECT_EQ(window->SelectedContact(), "");
  });
}

TEST_F(MembersList, StaysSelectedWhenTheRowIsClickedWithControl) {
  Open([this] {
    Click(1);
    QTest::mouseClick(List().viewport(), Qt::LeftButton, Qt::ControlModifier,
                      List().visualRect(Rows().index(1, 0)).center());
    EXPECT_EQ(Selected(), "Alice Belmont");
    EXPECT_EQ(Text("LastNameEntry"), "Belmont");
  });
}

TEST_F(MembersList, MovesTheFormByAClickAlsoOutOfTheSearchBox) {
  Open([this] {
    Click(2);
    EXPECT_EQ(Text("LastNameEntry"), "O'Brien");
    EXPECT_TRUE(List().hasFocus());
    ASSERT_TRUE(TypeUntil("m", 2));
    Click(1);
    EXPECT_EQ(Text("LastNameEntry"), "Belmont");
    EXPECT_EQ(Shown("DataPlace"), "2 / 2");
  });
}

TEST_F(MembersList, TakesAClickBeforeThePauseAmongTheNewHits) {
  Open([this] {
    Enter("SearchText", "mole");
    Click(0);
    EXPECT_THAT(Listed(), ElementsAre("Alice Belmont"));
    EXPECT_EQ(Text("LastNameEntry"), "Belmont");
  });
}

TEST_F(MembersList, TakesTheRowUnderTheMouseAlsoWhenItLiesFarBelowTheForms) {
  for (int i = 0; i < 60; ++i) {
    Sql("INSERT INTO Members (FirstName, LastName) VALUES ('Member', '" + std::to_string(i) + "')");
  }
  Open([this] {
    ASSERT_TRUE(TypeUntil("member", 60));
    Line("SearchText").setFocus();
    List().scrollToBottom();
    Click(56);  // the search that runs then shows the first of them
    EXPECT_EQ(Text("LastNameEntry"), "56");
    EXPECT_EQ(Selected(), "Member 56");
  });
}

TEST_F(MembersList, MovesTheFormForAScreenReader) {
  Open([this] {
    List().selectionModel()->select(Rows().index(3, 0), QItemSelectionModel::ClearAndSelect);
    EXPECT_EQ(Text("LastNameEntry"), "王");
    EXPECT_EQ(List().currentIndex().row(), 3);
  });
}

TEST_F(MembersList, WritesTheRowBackThatItLeaves) {
  Open([this] {
    Enter("FirstNameEntry", "Rhodri");
    Click(1);
    EXPECT_EQ(Stored("FirstName", 1), "Rhodri");
    EXPECT_EQ(Listed().front(), "Rhodri Morgan");
  });
}

TEST_F(MembersList, StaysOnTheRowThatCannotBeWrittenBack) {
  Open([this] {
    Enter("FirstNameEntry", "Rhodri");
    Sql("DELETE FROM Members WHERE ContactID = 1");
    Click(1);
    EXPECT_EQ(Selected(), "");  // the form's member is gone
    Click(1);
    EXPECT_EQ(Text("LastNameEntry"), "Belmont");
  });
  EXPECT_THAT(venue.Boxes.Boxes, SizeIs(1));
}

TEST_F(MembersList, ShowsNicknameAndLastGame) {
  Sql("UPDATE Members SET LastPlayedDate = '2026-11-20 20:15:00' WHERE ContactID = 2");
  Open([this] {
    EXPECT_EQ(Cell(1, MemberListModel::NickNameRole), "Mole");
    EXPECT_EQ(Cell(1, MemberListModel::LastPlayedRole), "Last played 20 Nov 2026");
    EXPECT_EQ(Cell(1, Qt::AccessibleTextRole), "Alice Belmont, Mole, Last played 20 Nov 2026");
    EXPECT_EQ(Cell(0, MemberListModel::LastPlayedRole), "Not played yet");
  });
}

TEST_F(MembersList, KeepsTheDateOfTheLastGameWhereItIsNarrow) {
  Sql("UPDATE Members SET LastPlayedDate = '2026-11-20 20:15:00'");
  Sql("UPDATE Members SET NickName = 'Wolfgang the Third' WHERE ContactID = 1");
  Sql("UPDATE Members SET NickName = NULL WHERE ContactID = 5");
  Open([this] {
    const QFontMetrics letters = List().fontMetrics();
    const auto details = [&](int row, const char* room) {
      const int width = letters.horizontalAdvance(QString::fromUtf8(room));
      return MemberDelegate::DetailsText(Rows().index(row, 0), letters, width).toStdString();
    };
    EXPECT_EQ(details(1, "Mole · Last played 20 Nov 2026"), "Mole · Last played 20 Nov 2026");
    EXPECT_EQ(details(1, "Mole · Last played 20 Nov"), "Mole · 20 Nov 2026");
    EXPECT_EQ(details(1, "Mo · 20 Nov 2026"), "Mole");
    EXPECT_THAT(details(0, "Wolfgang the · 20 Nov 2026"),
                testing::AllOf(testing::StartsWith("Wolf"), testing::EndsWith("… · 20 Nov 2026")));
    EXPECT_EQ(details(2, "Last played 20 Nov 2026"), "Last played 20 Nov 2026");
    EXPECT_EQ(details(2, "20 Nov 2026"), "20 Nov 2026");
    EXPECT_EQ(details(2, "20 Nov"), "20 Nov 2026");
  });
}

TEST_F(MembersList, IsReadableOnLightAndDarkDesktops) {
  Sql("INSERT INTO Members (FirstName, LastName) VALUES ('Rhys', 'Morgan')");
  const auto expectReadable = [this] {
    ASSERT_TRUE(QTest::qWaitFor(
        [this] { return Rows().index(4, 0).data(MemberListModel::SharedNameRole).toBool(); }));
    for (const int row : {0, 4}) {  // selected, not selected
      QRect cell = List().visualRect(Rows().index(row, 0));
      constexpr int photo = 50;
      const int mark = cell.right() - 24;
      cell.setLeft(cell.left() + photo);
      const QRect above(cell.topLeft(), QPoint(mark, cell.center().y()));
      const QRect below(QPoint(cell.left(), cell.center().y()), cell.bottomRight() - QPoint(2, 2));
      const QRect ring(QPoint(mark, cell.top() + 3), QPoint(cell.right() - 2, cell.center().y()));
      for (const QRect& part : {above, below, ring}) {
        EXPECT_GE(PaintedContrast(*List().viewport(), part), LeastContrast) << row;
      }
    }
  };
  Open(expectReadable);
  const DarkDesktop dark;
  Open(expectReadable);
}

TEST_F(MembersList, MarksMembersOfTheSameName) {
  Sql("INSERT INTO Members (FirstName, LastName) VALUES ('Rhys', 'Morgan')");
  Open([this] {
    const auto marked = [this](int row) {
      return Rows().index(row, 0).data(MemberListModel::SharedNameRole).toBool();
    };
    EXPECT_TRUE(QTest::qWaitFor([&] { return marked(0) && marked(4); }));
    EXPECT_FALSE(marked(1));
    EXPECT_EQ(Cell(0, Qt::ToolTipRole), "Several members have this name. OK takes the first of them.");
    EXPECT_EQ(Cell(1, Qt::ToolTipRole), "");
  });
}

TEST_F(MembersList, ShowsSmallPictures) {
  Open([this] {
    venue.Disk.Write(venue.Folder / "blue.png", PictureFile(Qt::blue));
    venue.Dialog.Answers = {venue.Folder / "blue.png"};
    Press("ChangePicture");
    const auto picture = [this] { return Rows().index(0, 0).data(Qt::DecorationRole).value<QPixmap>(); };
    ASSERT_TRUE(QTest::qWaitFor([&] { return !picture().isNull(); }));
    EXPECT_EQ(picture().toImage().pixelColor(5, 5), QColor(Qt::blue));
    EXPECT_TRUE(Rows().index(1, 0).data(Qt::DecorationRole).value<QPixmap>().isNull());
  });
}

TEST_F(MembersList, GainsANewMemberAndLosesADeletedOne) {
  Open([this] {
    Press("NewMember");
    EXPECT_THAT(Listed(), SizeIs(5));
    EXPECT_EQ(Selected(), "Enter Name Enter Name");
    venue.Boxes.Answers = {BoxAnswer::Ok};
    Press("Delete");
    EXPECT_THAT(Listed(), SizeIs(4));
    EXPECT_EQ(Selected(), "Rhys Morgan");
  });
}

TEST_F(MembersList, ComesBetweenSearchAndFormInTheTabOrder) {
  Open([this] {
    ::Find<QPushButton>(*window, "ClearSearch").setFocus();
    Type(*window, Qt::Key_Tab);
    EXPECT_TRUE(List().hasFocus());
    Type(*window, Qt::Key_Tab);
    EXPECT_TRUE(Line("FirstNameEntry").hasFocus());
    EXPECT_EQ(QAccessible::queryAccessibleInterface(&List())->text(QAccessible::Name),
              QStringLiteral("Members found"));
  });
}

}  // namespace
