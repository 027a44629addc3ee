#include "app/Desk.h"

#include <gmock/gmock.h>

#include <QHeaderView>
#include <QLabel>
#include <QToolButton>
#include <set>

#include "board/MissionResultEntry.h"
#include "settings/SoldieringCalc.h"
#include "tests/support/Contrast.h"
#include "tests/support/Frames.h"
#include "tests/support/Venue.h"
#include "tests/support/WhileModal.h"

namespace {

using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::IsSupersetOf;

/// The main window's status line and the bar under its banner.
class DeskOf : public testing::Test {
 protected:
  explicit DeskOf(Language language = Language::English) : venue(language) {
    venue.Time.DateAndTime = "2026-11-21 20:15:09";
    venue.PutDefaultFiles();
    venue.ChangeDatabase("members.mdb",
                         "DELETE FROM Members; INSERT INTO Members (ContactID, NickName, DallasID) VALUES"
                         " (7, 'Mole', 'AB00000000000001')");
    venue.Start();
    venue.Port.OnOutput = [this](std::uint8_t byte) { Answer(byte); };
  }

  /// The base unit has these frames from now on.
  void PutFrames(std::vector<Bytes> present) { frames_ = std::move(present); }

  void Pull() { venue.Press("GetScores"); }

  std::string Says(const std::string& entry) const {
    const auto* control = venue.Window->findChild<QWidget*>(QString::fromStdString(entry));
    return control != nullptr && control->isVisible() ? control->property("text").toString().toStdString()
                                                      : std::string();
  }
  void Follow(const std::string& link) const {
    QCoreApplication::processEvents();
    QTest::mouseClick(&venue.Find<QToolButton>(link), Qt::LeftButton);
  }

  QToolButton& Button(const std::string& name) const { return venue.Find<QToolButton>(name); }

  void ExpectTextsToBeReadable() {
    PutFrames({FrameOfRed1(), WithWrongCheckByte(FrameOfBlue0())});
    Pull();
    QCoreApplication::processEvents();
    for (const char* text :
         {"DeskGame", "Status", "PullAgainLink", "DeskUnsavedLink", "BarSave", "BarClear"}) {
      const auto& control = venue.Find<QWidget>(text);
      EXPECT_GE(PaintedContrast(*venue.Window, {control.mapTo(venue.Window.get(), QPoint()), control.size()}),
                LeastContrast)
          << text;
    }
  }

  bool IsTicked(const std::string& name) const { return !Button(name).accessibleDescription().isEmpty(); }

  Venue venue;

 private:
  void Answer(std::uint8_t byte) {
    if (byte == 1) {
      asked_ = true;
      next_ = 0;
      return;
    }
    if (asked_) {
      asked_ = false;
      venue.Port.Receive({static_cast<std::uint8_t>(frames_.size())});
    }
    if (next_ < frames_.size()) {
      venue.Port.Receive(frames_[next_++]);
    }
  }

  std::vector<Bytes> frames_ = {FrameOfRed1()};
  std::size_t next_ = 0;
  bool asked_ = false;
};

TEST_F(DeskOf, SaysWhatIsOnTheBoard) {
  EXPECT_EQ(Says("DeskGame"), "No game on the board");
  Pull();
  EXPECT_EQ(Says("DeskGame"), "Players: 1, 21/05/2013 14:30, None");
  EXPECT_EQ(Says("DeskUnsavedLink"), "Not saved");
  EXPECT_EQ(Says("DeskCountedTwiceLink"), "");
  venue.Boxes.Answers = {BoxAnswer::Ok};
  venue.Trigger("mnuClearScores");
  EXPECT_EQ(Says("DeskGame"), "No game on the board");
  EXPECT_EQ(Says("DeskUnsavedLink"), "");
}

TEST_F(DeskOf, SaysWhatWasCountedTwiceAndShowsIt) {
  PutFrames({FrameOfRed1(), FrameOfBlue0()});
  Pull();
  PutFrames({FrameOfBlue0()});
  Pull();
  EXPECT_EQ(Says("DeskCountedTwiceLink"), "Guns counted twice: 1");
  Follow("DeskCountedTwiceLink");
  const auto& board = venue.Find<QTableView>("ScoreDisplay");
  const QModelIndexList rows = board.selectionModel()->selectedRows(1);
  ASSERT_EQ(rows.size(), 1);
  EXPECT_EQ(rows.front().data().toString(), QStringLiteral("Blue  0"));
  EXPECT_EQ(venue.Window->focusWidget(), &board);
}

TEST_F(DeskOf, PullsAgainAfterAFailedDownload) {
  PutFrames({FrameOfRed1(), WithWrongCheckByte(FrameOfBlue0())});
  Pull();
  EXPECT_EQ(Says("Status"), "Download incomplete. Guns received: 1 of 2.");
  EXPECT_EQ(Says("PullAgainLink"), "Get them again");
  PutFrames({FrameOfRed1(), FrameOfBlue0()});
  Follow("PullAgainLink");
  EXPECT_EQ(Says("Status"), "");
  EXPECT_EQ(Says("PullAgainLink"), "");
  EXPECT_EQ(venue.RowCount("ScoreDisplay"), 2);
  EXPECT_EQ(Says("DeskCountedTwiceLink"), "");
}

TEST_F(DeskOf, ForgetsAFailedDownloadWithItsGame) {
  PutFrames({FrameOfRed1(), WithWrongCheckByte(FrameOfBlue0())});
  Pull();
  ASSERT_NE(Says("Status"), "");
  venue.Boxes.Answers = {BoxAnswer::Ok};
  venue.Trigger("mnuClearScores");
  EXPECT_EQ(Says("Status"), "");
  EXPECT_EQ(Says("PullAgainLink"), "");
}

TEST_F(DeskOf, SavesAGameThatIsNotSavedUnderASuggestedName) {
  Pull();
  venue.Dialog.Answers = {venue.Folder / "mine.xml"};
  Follow("DeskUnsavedLink");
  ASSERT_EQ(venue.Dialog.Calls.size(), 1U);
  EXPECT_EQ(venue.Dialog.Calls[0].Name, "2026-11-21 2015 None.game.xml");
  EXPECT_EQ(Says("DeskUnsavedLink"), "");
  EXPECT_TRUE(IsTicked("BarSave"));
  venue.Trigger("mnuSaveScores");
  EXPECT_EQ(venue.Dialog.Calls[1].Name, venue.Folder / "mine.xml") << "it has a name now";
  EXPECT_EQ(Says("DeskFileOfCancel"),
            "Cancelled, but saved to the last file: " + (venue.Folder / "mine.xml"));
  Follow("FolderOfCancelLink");
  EXPECT_THAT(venue.Started.Started, ElementsAre(ElementsAre("xdg-open", venue.Folder.Path())));
  venue.Dialog.Answers = {venue.Folder / "mine.xml"};
  venue.Trigger("mnuSaveScores");
  EXPECT_EQ(Says("DeskFileOfCancel"), "");
}

TEST_F(DeskOf, OpensTheDialogWhereTheLastRunSaved) {
  Pull();
  venue.Dialog.Answers = {venue.Folder / "mine.xml"};
  venue.Trigger("mnuSaveScores");
  venue.Window.reset();
  venue.Start();
  Pull();
  venue.Trigger("mnuSaveScores");
  EXPECT_EQ(venue.Dialog.Calls.back().Folder, venue.Folder.Path());
  EXPECT_EQ(venue.Dialog.Calls.back().Name, "2026-11-21 2015 None.game.xml");
  EXPECT_EQ(ReadFile(venue.DataFile("tessarine.ini")).find("save_folder"), std::string::npos);
}

TEST_F(DeskOf, CountsCommitsAndCommits) {
  const std::string member = "<DallasID>AB00000000000001</DallasID>";
  venue.LoadGame(GameFile(PlayerOf(1, member) + PlayerOf(40)));
  EXPECT_EQ(Says("DeskCommittedLink"), "Committed: 0 of 1");
  Follow("DeskCommittedLink");
  ASSERT_EQ(venue.Boxes.Boxes.size(), 1U);
  EXPECT_EQ(venue.Boxes.Boxes[0].Title, "Update Success");
  EXPECT_EQ(Says("DeskCommitted"), "Committed: 1 of 1");
  EXPECT_EQ(Says("DeskUnsavedLink"), "Not saved");
  EXPECT_TRUE(IsTicked("BarCommit"));
}

TEST_F(DeskOf, NamesAMemberOnTwoGunsAndShowsThem) {
  const std::string member = "<MemberIndex>7</MemberIndex>";
  venue.LoadGame(GameFile(PlayerOf(1, member) + PlayerOf(2) + PlayerOf(40, member)));
  EXPECT_EQ(Says("DeskSharedMembersLink"), "On more than one gun: Mole");
  Follow("DeskSharedMembersLink");
  EXPECT_EQ(venue.Find<QTableView>("ScoreDisplay").selectionModel()->selectedRows().size(), 2);
}

TEST_F(DeskOf, RanksTheHighestFirstAgain) {
  venue.LoadGame(SmallGame());
  auto& board = venue.Find<QTableView>("ScoreDisplay");
  emit board.horizontalHeader()->sectionClicked(1);
  EXPECT_EQ(Says("DeskLowestFirstLink"), "");
  venue.OpenPopup(0, [](QMenu&) {});  // ends in a calculation
  EXPECT_EQ(Says("DeskLowestFirstLink"), "Ranks: lowest score first");
  ASSERT_THAT(venue.Column("ScoreDisplay", 1), ElementsAre("Red  0", "Blue  7"));
  Follow("DeskLowestFirstLink");
  EXPECT_THAT(venue.Column("ScoreDisplay", 1), ElementsAre("Blue  7", "Red  0"));
  EXPECT_THAT(venue.Column("ScoreDisplay", 0), ElementsAre("1", "2"));
  EXPECT_EQ(Says("DeskLowestFirstLink"), "");
}

TEST_F(DeskOf, GoesBackToTheMissionBefore) {
  venue.LoadGame(GameFile(PlayerOf(1) + PlayerOf(2,
                                                 "<HitData><HitByPlayer><Index>1</Index><Amount>30</Amount>"
                                                 "</HitByPlayer></HitData>")));
  EXPECT_EQ(Says("DeskMissionChangedLink"), "");
  venue.ActiveMission().setCurrentIndex(1);
  EXPECT_EQ(Says("DeskMissionChangedLink"), "Mission changed from None to Free For All, players rescored: 1");
  Follow("DeskMissionChangedLink");
  EXPECT_EQ(venue.ActiveMission().currentIndex(), 0);
  EXPECT_EQ(Says("DeskMissionChangedLink"), "Mission changed from Free For All to None, players rescored: 1");
}

TEST_F(DeskOf, SaysThatSettingsCouldNotBeSaved) {
  std::filesystem::remove(venue.DataFile("tessarine.ini"));
  std::filesystem::create_directory(venue.DataFile("tessarine.ini"));
  const auto saveFactors = [this] {
    const WhileModal<SoldieringCalc> close([](SoldieringCalc& window) { window.close(); });
    venue.Trigger("mnuSoldieringCalc");
  };
  saveFactors();
  EXPECT_THAT(Says("DeskSettings"), HasSubstr("tessarine.ini"));
  EXPECT_EQ(Says("FolderOfSettingsLink"), "Open Folder");
  std::filesystem::remove(venue.DataFile("tessarine.ini"));
  saveFactors();
  EXPECT_EQ(Says("DeskSettings"), "");
}

TEST_F(DeskOf, OffersTheStepsAfterAGameExactlyWhenTheMenuDoes) {
  const std::pair<const char*, const char*> steps[] = {{"BarResults", "mnuMissionResults"},
                                                       {"BarPrint", "mnuPrintScores"},
                                                       {"BarCommit", "mnuCommitGame"},
                                                       {"BarSave", "mnuSaveScores"},
                                                       {"BarClear", "mnuClearScores"}};
  for (const bool enabled : {false, true}) {
    for (const auto& [button, item] : steps) {
      venue.Find<QAction>(item).setEnabled(enabled);
      EXPECT_EQ(Button(button).isEnabled(), enabled) << button;
    }
  }
  venue.ActiveMission().setCurrentIndex(2);
  EXPECT_TRUE(Button("BarResults").isEnabled());
  venue.ActiveMission().setCurrentIndex(0);
  EXPECT_FALSE(Button("BarResults").isEnabled());
  QTest::mouseClick(&Button("BarClear"), Qt::LeftButton);
  ASSERT_EQ(venue.Boxes.Boxes.size(), 1U);
  EXPECT_EQ(venue.Boxes.Boxes[0].Title, "Confirm Clear");
}

TEST_F(DeskOf, TicksTheStepsThatAreDone) {
  Pull();
  venue.ActiveMission().setCurrentIndex(2);
  for (const char* button : {"BarResults", "BarPrint", "BarCommit", "BarSave", "BarClear"}) {
    EXPECT_FALSE(IsTicked(button)) << button;
  }
  const auto sign = [this] { return Button("BarResults").icon().pixmap(24).toImage(); };
  const QImage plain = sign();
  {
    const WhileModal<MissionResultEntry> closed([](MissionResultEntry& window) { window.close(); });
    venue.Trigger("mnuMissionResults");
    EXPECT_FALSE(IsTicked("BarResults"));
  }
  const WhileModal<MissionResultEntry> entered([](MissionResultEntry& window) { ::Press(window, "OK"); });
  QTest::mouseClick(&Button("BarResults"), Qt::LeftButton);
  EXPECT_EQ(entered.Runs(), 1);
  EXPECT_TRUE(IsTicked("BarResults"));
  EXPECT_NE(sign(), plain);
  venue.Boxes.Answers = {BoxAnswer::Ok};
  venue.Trigger("mnuClearScores");
  EXPECT_FALSE(IsTicked("BarResults"));
  EXPECT_TRUE(IsTicked("BarClear"));
}

TEST_F(DeskOf, ShowsSignsAloneWhereCaptionsDoNotFitAndNoBarInALowWindow) {
  auto& bar = venue.Find<AfterGameBar>("GameBar");
  venue.Window->resize(1100, 720);
  QCoreApplication::processEvents();
  EXPECT_TRUE(bar.isVisible());
  EXPECT_EQ(Button("BarSave").toolButtonStyle(), Qt::ToolButtonTextBesideIcon);
  bar.resize(bar.minimumSizeHint().width(), bar.height());
  EXPECT_EQ(Button("BarSave").toolButtonStyle(), Qt::ToolButtonIconOnly);
  EXPECT_EQ(Button("BarSave").accessibleName(), QStringLiteral("Save"));
  EXPECT_THAT(Button("BarSave").toolTip().toStdString(), HasSubstr("Save Game (Ctrl+S)"));
  venue.Window->resize(1100, 699);
  QCoreApplication::processEvents();
  EXPECT_FALSE(bar.isVisible());
  venue.Window->resize(1100, 700);
  QCoreApplication::processEvents();
  EXPECT_TRUE(bar.isVisible());
}

TEST_F(DeskOf, IsReachedByTab) {
  Pull();
  std::set<std::string> reached;
  for (int i = 0; i < 20; ++i) {
    Type(*venue.Window, Qt::Key_Tab);
    reached.insert(venue.Window->focusWidget()->objectName().toStdString());
  }
  EXPECT_THAT(reached, IsSupersetOf({"BarPrint", "BarCommit", "BarSave", "BarClear", "DeskUnsavedLink"}));
  EXPECT_FALSE(reached.contains("BarResults")) << "there is no mission";
  venue.Find<QWidget>("RemoteManageButton").setFocus();
  Type(*venue.Window, Qt::Key_Tab);
  EXPECT_EQ(venue.Window->focusWidget(), &Button("BarPrint")) << "the next one below";
}

TEST_F(DeskOf, LeavesTheKeyboardToTheBoardWhenALinkWasPressedByAKey) {
  PutFrames({FrameOfRed1(), WithWrongCheckByte(FrameOfBlue0())});
  Pull();
  const auto press = [this](const char* link) {
    QCoreApplication::processEvents();
    Button(link).setFocus();
    Type(*venue.Window, Qt::Key_Space);
  };
  PutFrames({FrameOfRed1()});
  std::set<QWidget*> duringThePull;
  venue.Events.OnSleep = [&](auto /*time*/) { duringThePull.insert(venue.Window->focusWidget()); };
  press("PullAgainLink");
  EXPECT_THAT(duringThePull, ElementsAre(&venue.Find<QWidget>("ScoreDisplay")));
  venue.Dialog.Answers = {venue.Folder / "mine.xml"};
  venue.Trigger("mnuSaveScores");
  venue.Trigger("mnuSaveScores");
  press("FolderOfCancelLink");
  EXPECT_EQ(venue.Started.Started.size(), 1U);
  EXPECT_EQ(venue.Window->focusWidget(), &venue.Find<QWidget>("ScoreDisplay"));
}

TEST_F(DeskOf, CanBeReadOnALightDesktop) {
  ExpectTextsToBeReadable();
}

/// The desktop is dark before the window is made.
struct DarkBefore {
  DarkDesktop Dark;
};
class DeskOnDark : private DarkBefore, public DeskOf {};

TEST_F(DeskOnDark, CanBeRead) {
  ExpectTextsToBeReadable();
}

TEST_F(DeskOf, TakesTheKeysOfTheSteps) {
  Pull();
  for (const auto& [key, item] : {std::pair{Qt::Key_M, "mnuCommitGame"},
                                  {Qt::Key_L, "mnuClearScores"},
                                  {Qt::Key_R, "mnuMissionResults"},
                                  {Qt::Key_P, "mnuPrintScores"},
                                  {Qt::Key_S, "mnuSaveScores"}}) {
    EXPECT_EQ(venue.Find<QAction>(item).shortcut(), QKeySequence(Qt::CTRL | key)) << item;
  }
  Type(*venue.Window, Qt::Key_M, Qt::ControlModifier);
  Type(*venue.Window, Qt::Key_L, Qt::ControlModifier);
  ASSERT_EQ(venue.Boxes.Boxes.size(), 2U);
  EXPECT_EQ(venue.Boxes.Boxes[0].Title, "Update Success");
  EXPECT_EQ(venue.Boxes.Boxes[1].Title, "Confirm Clear");
}

}  // namespace
