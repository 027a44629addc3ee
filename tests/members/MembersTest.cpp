#include <QAccessible>
#include <QGroupBox>

#include "members/MemberListView.h"
#include "tests/members/MembersWindow.h"
#include "tests/support/OnScreen.h"

namespace {

using testing::ElementsAre;
using testing::IsEmpty;

TEST_F(MembersWindow, HasItsCaptions) {
  Open([this] {
    EXPECT_EQ(window->windowTitle(), QStringLiteral("Members"));
    for (const auto& [button, caption] : {std::pair{"Search", "Search"},
                                          {"ClearSearch", "Clear Search"},
                                          {"NewMember", "Add New"},
                                          {"Delete", "Delete"},
                                          {"OK", "OK"},
                                          {"ChangeID", "Change"},
                                          {"ChangePicture", "Change Picture"}}) {
      EXPECT_EQ(::Find<QPushButton>(*window, button).text().toStdString(), caption);
    }
    for (const auto& [frame, caption] : {std::pair{"NameFrame", "Member"},
                                         {"PersonalDetails", "Personal Details"},
                                         {"ContactDetails", "Contact Details"},
                                         {"MemberIDFrame", "Member ID"},
                                         {"HistoryFrame", "Playing History"},
                                         {"DamageFrame", "Damage Inflicted"},
                                         {"Soldiering", "Soldiering"},
                                         {"AccuracyFrame", "Average Accuracy"}}) {
      EXPECT_EQ(::Find<QGroupBox>(*window, frame).title().toStdString(), caption);
    }
  });
}

TEST_F(MembersWindow, LabelsEachEntryAndFigure) {
  Open([this] {
    for (const auto& [control, caption] : {std::pair{"FirstNameEntry", "First Name:"},
                                           {"LastNameEntry", "Last Name:"},
                                           {"NickNameEntry", "Nickname:"},
                                           {"DOBPicker", "Date of Birth:"},
                                           {"ClanEntry", "Clan:"},
                                           {"AddressEntry", "Address:"},
                                           {"CityEntry", "City:"},
                                           {"PostCodeEntry", "Post/Zip Code:"},
                                           {"EmailEntry", "Email:"},
                                           {"PhoneNumberEntry", "Phone:"},
                                           {"MemberIDDisplay", "Member ID Code:"},
                                           {"DateJoinedDisplay", "Date Joined:"},
                                           {"LastPlayedDisplay", "Last Played:"},
                                           {"TotalGamesPlayedDisplay", "Total Games Played:"},
                                           {"TotalDamageDisplay", "Total:"},
                                           {"AverageDamageDisplay", "Average:"},
                                           {"TotalSoldieringDisplay", "Total:"},
                                           {"AverageSoldieringDisplay", "Average:"},
                                           {"PrimaryAccuracyDisplay", "Primary:"},
                                           {"SecondaryAccuracyDisplay", "Secondary:"}}) {
      const QWidget& target = ::Find<QWidget>(*window, control);
      std::vector<std::string> captions;
      for (const QLabel* label : window->findChildren<QLabel*>()) {
        if (label->buddy() == &target) {
          captions.push_back(label->text().toStdString());
        }
      }
      EXPECT_THAT(captions, ElementsAre(caption)) << control;
    }
  });
}

TEST_F(MembersWindow, NamesItsFramesAndButtonsToAssistivePrograms) {
  const auto nameOf = [](QWidget* control) {
    return QAccessible::queryAccessibleInterface(control)->text(QAccessible::Name).toStdString();
  };
  Open([&] {
    for (QGroupBox* frame : window->findChildren<QGroupBox*>()) {
      EXPECT_EQ(nameOf(frame), frame->title().toStdString());
    }
    for (QAbstractButton* button : window->findChildren<QAbstractButton*>()) {
      EXPECT_NE(nameOf(button), "") << button->parent()->objectName().toStdString();
    }
  });
}

TEST_F(MembersWindow, OpensOnTheFirstMember) {
  Open([this] {
    EXPECT_EQ(Text("FirstNameEntry"), "Rhys");
    EXPECT_EQ(Text("LastNameEntry"), "Morgan");
    EXPECT_EQ(Text("NickNameEntry"), "");
    EXPECT_EQ(Text("DOBPicker"), "12 Apr 1961");
    EXPECT_EQ(Text("ClanEntry"), "Red Dragons");
    EXPECT_EQ(Text("CityEntry"), "Cardiff");
    EXPECT_EQ(Text("SearchText"), "");
    EXPECT_EQ(Shown("DataPlace"), "1 / 4");
    EXPECT_FALSE(::Find<QLabel>(*window, "Dummy").isVisible());
  });
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
}

TEST_F(MembersWindow, ShowsEveryBoundColumn) {
  Sql("UPDATE Members SET NickName = 'Dai', Address = '1 High St', PostalCode = 'CF10', EmailName = "
      "'r@m.wales', PhoneNumber = '029', DallasID = 'EFCDAB8967452301', LastPlayedDate = "
      "'2026-11-20 20:15:00' WHERE ContactID = 1");
  Open([this] {
    EXPECT_EQ(Text("NickNameEntry"), "Dai");
    EXPECT_EQ(Text("AddressEntry"), "1 High St");
    EXPECT_EQ(Text("PostCodeEntry"), "CF10");
    EXPECT_EQ(Text("EmailEntry"), "r@m.wales");
    EXPECT_EQ(Text("PhoneNumberEntry"), "029");
    EXPECT_EQ(Shown("MemberIDDisplay"), "EFCDAB8967452301");
    EXPECT_EQ(Shown("DateJoinedDisplay"), "1 Mar 2010 09:05:00");
    EXPECT_EQ(Shown("LastPlayedDisplay"), "20 Nov 2026 20:15:00");
  });
}

TEST_F(MembersWindow, ShowsThePlayingHistory) {
  Sql("UPDATE Members SET TotalGamesPlayed = 12, TotalDamage = 3450, AverageDamage = 287.5, TotalSoldiering "
      "= -7, AverageSoldiering = -0.58, AveragePrimAccuracy = 0.3456, AverageSecAccuracy = 0.5 WHERE "
      "ContactID = 1");
  Open([this] {
    EXPECT_EQ(Shown("TotalGamesPlayedDisplay"), "12");
    EXPECT_EQ(Shown("TotalDamageDisplay"), "3450");
    EXPECT_EQ(Shown("AverageDamageDisplay"), "287.5");
    EXPECT_EQ(Shown("TotalSoldieringDisplay"), "-7");
    EXPECT_EQ(Shown("AverageSoldieringDisplay"), "-0.58");
    EXPECT_EQ(Shown("PrimaryAccuracyDisplay"), "34.56%");
    EXPECT_EQ(Shown("SecondaryAccuracyDisplay"), "50.00%");
    Press("DataNext");
    EXPECT_EQ(Shown("TotalGamesPlayedDisplay"), "0");
    EXPECT_EQ(Shown("AverageDamageDisplay"), "0");
    EXPECT_EQ(Shown("PrimaryAccuracyDisplay"), "N/A");
    EXPECT_EQ(Shown("SecondaryAccuracyDisplay"), "N/A");
    EXPECT_EQ(Shown("DateJoinedDisplay"), "");
  });
}

TEST_F(MembersWindow, GoesThroughTheRowsByItsArrowsAndStopsAtTheEnds) {
  Open([this] {
    Press("DataPrevious");
    EXPECT_EQ(Text("LastNameEntry"), "Morgan");
    EXPECT_EQ(Found(), "Morgan Belmont O'Brien 王 ");
    Press("DataPrevious");
    EXPECT_EQ(Text("LastNameEntry"), "O'Brien");
    Press("DataFirst");
    EXPECT_EQ(Text("LastNameEntry"), "Morgan");
    Press("DataLast");
    EXPECT_EQ(Text("FirstNameEntry"), "小明");
    EXPECT_EQ(Shown("DataPlace"), "4 / 4");
    EXPECT_EQ(Shown("Dummy"), "9");
  });
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
}

TEST_F(MembersWindow, OpensOnAnEmptyTableAndTakesTheFirstMember) {
  Sql("DELETE FROM Members");
  Open([this] {
    EXPECT_EQ(Text("FirstNameEntry"), "");
    EXPECT_FALSE(Line("FirstNameEntry").isEnabled());
    for (const char* arrow : {"DataFirst", "DataPrevious", "DataNext", "DataLast"}) {
      Press(arrow);
    }
    EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
    Press("OK");
    for (const char* button : {"ChangePicture", "Delete", "ChangeID"}) {
      EXPECT_FALSE(::Find<QPushButton>(*window, button).isEnabled()) << button;
    }
    EXPECT_TRUE(window->isVisible());
    EXPECT_EQ(window->SelectedContact(), "");
    Press("NewMember");
    EXPECT_TRUE(Line("FirstNameEntry").isEnabled());
    EXPECT_EQ(Text("FirstNameEntry"), "Enter Name");
    for (const char* button : {"ChangePicture", "Delete", "ChangeID"}) {
      EXPECT_TRUE(::Find<QPushButton>(*window, button).isEnabled()) << button;
    }
  });
  EXPECT_THAT(venue.Boxes.Boxes, ElementsAre(Fault(3021, "No current record.")));
  EXPECT_EQ(Query("SELECT count(*) FROM Members"), "1");
}

TEST_F(MembersWindow, ChoosesTheMemberInViewByOk) {
  Open([this] {
    Press("DataNext");
    Press("OK");
    EXPECT_EQ(window->SelectedContact(), "2");
    EXPECT_FALSE(window->isVisible());
  });
}

TEST_F(MembersWindow, ChoosesByReturnInAnEntry) {
  Open([this] {
    Press("DataNext");
    Line("CityEntry").setFocus();
    Type(*window, Qt::Key_Return);
    EXPECT_EQ(window->SelectedContact(), "2");
    EXPECT_FALSE(window->isVisible());
  });
}

TEST_F(MembersWindow, ChoosesAMemberWithAnApostrophe) {
  Open([this] {
    SearchFor("sham");
    Enter("FirstNameEntry", "O'Sean");
    Press("OK");
    EXPECT_EQ(window->SelectedContact(), "5");
  });
  EXPECT_EQ(Stored("FirstName || LastName", 5), "O'SeanO'Brien");
}

TEST_F(MembersWindow, ChoosesTheFirstOfTwoWithTheSameNames) {
  Sql("INSERT INTO Members (ContactID, FirstName, LastName) VALUES (12, 'Alice', 'Belmont')");
  Open([this] {
    Press("DataLast");
    EXPECT_EQ(Shown("Dummy"), "12");
    Press("OK");
    EXPECT_EQ(window->SelectedContact(), "2");
  });
}

TEST_F(MembersWindow, ChoosesByTheNamesJustTyped) {
  Open([this] {
    Enter("FirstNameEntry", "Dai");
    Press("OK");
    EXPECT_EQ(window->SelectedContact(), "1");
  });
  EXPECT_EQ(Stored("FirstName", 1), "Dai");
}

TEST_F(MembersWindow, ChoosesNobodyWhoseNameIsNotStored) {
  Sql("UPDATE Members SET FirstName = NULL WHERE ContactID = 1");
  Open([this] {
    Press("OK");
    EXPECT_TRUE(window->isVisible());
    EXPECT_EQ(window->SelectedContact(), "");
  });
  EXPECT_THAT(venue.Boxes.Boxes, ElementsAre(Fault(3021, "No current record.")));
}

TEST_F(MembersWindow, ChoosesNobodyWhenItIsClosed) {
  Open([this] {
    Press("DataNext");
    window->close();
    EXPECT_EQ(window->SelectedContact(), "");
    EXPECT_FALSE(window->isVisible());
  });
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
}

TEST_F(MembersWindow, DoesByEscapeWhatOkDoes) {
  Open([this] {
    Press("DataNext");
    Enter("FirstNameEntry", "Alicia");
    Type(*window, Qt::Key_Escape);
    EXPECT_EQ(window->SelectedContact(), "2");
    EXPECT_FALSE(window->isVisible());
  });
  EXPECT_EQ(Stored("FirstName", 2), "Alicia");
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
}

/// The window opened on one member.
class MembersWindowOn : public MembersWindow {
 protected:
  Members& OpenOn(std::int32_t contactToShow) {
    opened = std::make_unique<Members>(Members::Parts{.DbMembers = *database,
                                                      .Boxes = venue.Boxes,
                                                      .CommonDialog1 = venue.Dialog,
                                                      .Disk = venue.Disk,
                                                      .Time = venue.Time,
                                                      .Strings = venue.Strings},
                                       nullptr);
    opened->ContactToShow = contactToShow;
    window = opened.get();
    Show(*window);
    EXPECT_TRUE(QTest::qWaitFor([this] { return QApplication::activeWindow() == window; }));
    return *window;
  }

  std::unique_ptr<Members> opened;
};

TEST_F(MembersWindowOn, StandsOnTheMemberToShowAmongAll) {
  OpenOn(5);
  EXPECT_EQ(Text("LastNameEntry"), "O'Brien");
  EXPECT_EQ(Shown("DataPlace"), "3 / 4");
  Press("DataNext");
  EXPECT_EQ(Text("LastNameEntry"), "王");
}

TEST_F(MembersWindowOn, HasThatMemberInViewInItsList) {
  for (int i = 0; i < 60; ++i) {
    Sql("INSERT INTO Members (ContactID, FirstName, LastName) VALUES (" + std::to_string(100 + i) +
        ", 'Member', '" + std::to_string(i) + "')");
  }
  OpenOn(150);
  EXPECT_EQ(Text("LastNameEntry"), "50");
  const auto& list = ::Find<MemberListView>(*window, "MemberHits");
  EXPECT_EQ(list.currentIndex().data().toString(), QStringLiteral("Member 50"));
  EXPECT_TRUE(list.viewport()->rect().contains(list.visualRect(list.currentIndex())));
}

TEST_F(MembersWindowOn, OpensWithRoomForNamesInItsListInLargeLettersToo) {
  for (const int points : {9, 14}) {
    const FontOfSize font(points);
    OpenOn(5);
    const auto& list = ::Find<MemberListView>(*window, "MemberHits");
    EXPECT_GE(list.viewport()->width(), list.fontMetrics().horizontalAdvance(QStringLiteral("Alice Belmont")))
        << points;
  }
}

TEST_F(MembersWindowOn, StandsOnTheFirstMemberForNone) {
  OpenOn(0);
  EXPECT_EQ(Text("LastNameEntry"), "Morgan");
}

TEST_F(MembersWindowOn, StandsBehindTheLastRowForAMemberThatIsGone) {
  OpenOn(77);
  EXPECT_EQ(Text("LastNameEntry"), "");
  EXPECT_FALSE(Line("LastNameEntry").isEnabled());
  EXPECT_FALSE(::Find<QPushButton>(*window, "ChangePicture").isEnabled());
  EXPECT_FALSE(::Find<QPushButton>(*window, "Delete").isEnabled());
  Press("DataPrevious");
  EXPECT_EQ(Text("LastNameEntry"), "王");
}

TEST_F(MembersWindowOn, IsUpToDateWheneverItComesUp) {
  OpenOn(0);
  SearchFor("mole");
  window->hide();
  Sql("INSERT INTO Members (ContactID, FirstName, LastName) VALUES (12, 'New', 'One')");
  window->ContactToShow = 12;
  Show(*window);
  EXPECT_EQ(Text("SearchText"), "");
  EXPECT_EQ(Text("LastNameEntry"), "One");
  EXPECT_EQ(Shown("DataPlace"), "5 / 5");
}

TEST_F(MembersWindowOn, HasItsCaretNowhereSoThatAStrayKeyChangesNothing) {
  OpenOn(5);
  QTest::keyClicks(QApplication::focusWidget(), QStringLiteral("x "));
  EXPECT_EQ(Text("FirstNameEntry") + "|" + Text("SearchText"), "Sean|");
  EXPECT_EQ(Shown("DataPlace"), "3 / 4");
  Type(*window, Qt::Key_Tab);
  EXPECT_TRUE(Line("FirstNameEntry").hasFocus());
  EXPECT_EQ(Shown("DataPlace"), "3 / 4");
}

TEST_F(MembersWindowOn, ShowsTheLongestNumberOfAButtonWhole) {
  Sql("UPDATE Members SET DallasID = 'DDDDDDDDDDDDDDDD' WHERE ContactID = 5");
  for (const int points : {0, 11, 14}) {
    const FontOfSize font(points);
    OpenOn(5);
    const auto& code = ::Find<QLabel>(*window, "MemberIDDisplay");
    EXPECT_GE(code.width(), code.fontMetrics().horizontalAdvance(code.text())) << points;
    opened.reset();
  }
}

TEST_F(MembersWindowOn, HasNoIdToChangeWithoutAReader) {
  OpenOn(1);
  EXPECT_FALSE(::Find<QPushButton>(*window, "ChangeID").isEnabled());
}

}  // namespace
