#include "sheets/ScoreSheets.h"

#include "tests/sheets/SheetRun.h"

namespace {

using testing::Contains;
using testing::ElementsAre;
using testing::IsEmpty;
using testing::Not;
using testing::SizeIs;
using testing::StartsWith;
using Box = FakeMessageBoxes::Box;

TEST_F(Sheets, AreMadeForThePlayersWhoTookPart) {
  Run();
  EXPECT_THAT(Names(), ElementsAre("/data/scores/Red 0-Ann Lee-21 May 2013-Sniper Hunt.doc",
                                   "/data/scores/Blue 7-Guest-21 May 2013-Sniper Hunt.doc"));
  EXPECT_THAT(venue.Boxes.Boxes, ElementsAre(Completed));
  EXPECT_THAT(progress.Log, ElementsAre("Open", "1 of 2 Red 0-Ann Lee", "2 of 2 Blue 7-Guest", "Close"));
}

TEST_F(Sheets, FillTheTwentyBookmarksOfAMemberInOrder) {
  Run();
  EXPECT_EQ(Sheet(0).Template, "/data/score_card.doc");
  EXPECT_THAT(
      Sheet(0).BookmarkOrder,
      ElementsAre("Victory", "PlayerTeam", "PlayerID", "PlayerName", "NickName", "AvgGames", "AvgAccuracy",
                  "AvgDamage", "AvgSoldiering", "ClanName", "MissionName", "Date", "Rank", "TotalDamage",
                  "Soldiering", "ShotsFired", "Accuracy", "WIA", "KIA", "AmmoAdds"));
  EXPECT_EQ(Sheet(0).Bookmarks.at("Rank"), " 2");
  EXPECT_EQ(Sheet(0).Bookmarks.at("Date"), "21 May 2013");
  EXPECT_EQ(Sheet(0).Bookmarks.at("MissionName"), "Sniper Hunt");
  EXPECT_EQ(Sheet(1).Bookmarks.count("NickName"), 0u);
  EXPECT_THAT(Sheet(1).BookmarkOrder, SizeIs(19));
}

TEST_F(Sheets, HideTheRankWhenAsked) {
  choice.RankHidden = true;
  Run();
  EXPECT_EQ(Sheet(0).Bookmarks.at("Rank"), "N/A");
}

TEST_F(Sheets, SayWhoWon) {
  venue.game.TeamTotals(2) = 5;
  Run();
  EXPECT_EQ(Sheet(0).Bookmarks.at("Victory"), "Team Lost!");
  EXPECT_EQ(Sheet(1).Bookmarks.at("Victory"), "Team Won!");
}

TEST_F(Sheets, ListHitsInTablesFourAndFive) {
  venue.game.Players(40).HitByPlayer(1) = 20;
  Run();
  EXPECT_THAT(Sheet(0).Cells.at(4), ElementsAre("Blue 7:  20"));
  EXPECT_THAT(Sheet(0).Cells.at(5), IsEmpty());
  EXPECT_THAT(Sheet(1).Cells.at(5), ElementsAre("Red 0:  20  (Mole)"));
}

TEST_F(Sheets, PutThePhotoInAndDeleteItsFile) {
  std::string photo;
  word.OnOperation = [&](const std::string& operation) {
    if (operation == "AddPicture 1 1 1") {
      photo = files.Contents().at("/tmp/per1");
    }
  };
  Run();
  EXPECT_EQ(photo, std::string("\1\2\3\4"));
  EXPECT_EQ(Sheet(0).Picture, "/tmp/per1");
  EXPECT_EQ(files.Contents().count("/tmp/per1"), 0u);
  EXPECT_EQ(Sheet(1).Picture, "");
}

TEST_F(Sheets, TurnThePhotoUpright) {
  std::string photo;
  upright = [](const std::string& bytes) { return "upright " + bytes; };
  word.OnOperation = [&](const std::string& operation) {
    if (operation == "AddPicture 1 1 1") {
      photo = files.Contents().at("/tmp/per1");
    }
  };
  Run();
  EXPECT_EQ(photo, std::string("upright \1\2\3\4"));
  EXPECT_EQ(files.Contents().count("/tmp/per1"), 0u);
}

TEST_F(Sheets, ShowTheOwnPhotoWhenACommandMeanwhileLooksAnotherMemberUp) {
  std::string photo;
  word.OnOperation = [&](const std::string& operation) {
    if (operation == "SetBookmark ClanName") {
      events.At(std::chrono::milliseconds(0), [this] { venue.Members->LoadMember(4); });
    } else if (operation == "AddPicture 1 1 1") {
      photo = files.Contents().at("/tmp/per1");
    }
  };
  Run();
  EXPECT_EQ(photo, std::string("\1\2\3\4"));
}

TEST_F(Sheets, LeaveTheEmptyFileOfAMemberWithoutAPhoto) {
  venue.game.Players(1).MemberIndex = 4;
  Run();
  EXPECT_EQ(Sheet(0).Picture, "");
  EXPECT_EQ(files.Contents().at("/tmp/per1"), "");
}

TEST_F(Sheets, TreatAMemberWhoIsGoneAsAGuest) {
  venue.game.Players(1).MemberIndex = 99;
  Run();
  EXPECT_EQ(Sheet(0).Bookmarks.at("PlayerName"), "Guest");
  EXPECT_THAT(venue.Boxes.Boxes, ElementsAre(Box{"Could not locate specified Member in database!",
                                                 "Member Error", BoxIcon::Exclamation, BoxButtons::Ok},
                                             Completed));
}

TEST_F(Sheets, OfAllAre224) {
  choice.SheetSelection = SheetSelection::All;
  Run();
  EXPECT_THAT(word.Documents, SizeIs(224));
  EXPECT_EQ(Sheet(223).Bookmarks.at("PlayerID"), " 95 ");
  EXPECT_EQ(Sheet(223).Bookmarks.at("ShotsFired"), " 0");
}

TEST_F(Sheets, OfATeamIncludeThoseWhoTookNoPart) {
  choice.SheetSelection = SheetSelection::Team;
  choice.SelectedTeam = 3;
  Run();
  EXPECT_THAT(word.Documents, SizeIs(32));
  EXPECT_EQ(Sheet(0).Bookmarks.at("PlayerTeam"), "Yellow");
}

TEST_F(Sheets, OfOnePlayerAreOne) {
  choice.SheetSelection = SheetSelection::OnePlayer;
  choice.SelectedTeam = 2;
  choice.SelectedNumber = 40;
  Run();
  EXPECT_THAT(Names(), ElementsAre("/data/scores/Blue 40-Guest-21 May 2013-Sniper Hunt.doc"));
}

TEST_F(Sheets, OfAPlayerWhoDoesNotExistAreNotMadeAndTheRunEndsAtOnce) {
  choice.SheetSelection = SheetSelection::OnePlayer;
  choice.OutputTarget = 0;
  choice.SelectedTeam = 3;
  choice.SelectedNumber = 40;
  Run();
  EXPECT_THAT(word.Log, IsEmpty());
  EXPECT_THAT(venue.Boxes.Boxes, ElementsAre(Completed));
}

TEST_F(Sheets, ForThePrinterAreSavedThenPrintedThenClosed) {
  venue.game.Players(40).Active = false;
  Run();
  const std::vector<std::string> end(word.Log.end() - 3, word.Log.end());
  EXPECT_THAT(end, ElementsAre(StartsWith("SaveAs"), "PrintOut", "Close"));
}

TEST_F(Sheets, ForFilesAreNotPrintedAndLeaveOnePdfOfAll) {
  choice.OutputTarget = OutputTarget::Files;
  Run();
  EXPECT_THAT(word.Log, Not(Contains("PrintOut")));
  EXPECT_EQ(word.Log.back(), "JoinPdfs 2 /data/scores/Score sheets-21 May 2013-Sniper Hunt.pdf");
  EXPECT_THAT(venue.Boxes.Boxes, ElementsAre(Closing("Printing completed. Files saved to /data/scores.")));
  EXPECT_THAT(files.Contents(), IsEmpty());
}

TEST_F(Sheets, TakeANumberWhenTheNameIsTaken) {
  files.Put("/data/scores/Red 0-Ann Lee-21 May 2013-Sniper Hunt.doc", "");
  files.Put("/data/scores/Blue 7-Guest-21 May 2013-Sniper Hunt.doc", "");
  files.Put("/data/scores/Blue 7-Guest-21 May 2013-Sniper Hunt 1.doc", "");
  Run();
  EXPECT_THAT(Names(), ElementsAre("/data/scores/Red 0-Ann Lee-21 May 2013-Sniper Hunt 1.doc",
                                   "/data/scores/Blue 7-Guest-21 May 2013-Sniper Hunt 2.doc"));
}

TEST_F(Sheets, MakeTheirFolderOnce) {
  Run();
  Run();
  EXPECT_THAT(files.Created, ElementsAre("/data/scores"));
}

TEST_F(Sheets, WaitForAWordProcessorThatIsStarting) {
  word.AfterStart = WordState::Starting;
  events.At(std::chrono::milliseconds(500), [this] { word.Now = WordState::Ready; });
  Run();
  EXPECT_THAT(word.Documents, SizeIs(2));
}

TEST_F(Sheets, WaitNoLongerThanAMinuteForTheWordProcessor) {
  word.AfterStart = WordState::Starting;
  Run();
  EXPECT_EQ(events.Now(), std::chrono::seconds(60));
  EXPECT_THAT(venue.Boxes.Boxes, ElementsAre(Failure("Could not locate score template file.")));
}

TEST_F(Sheets, EndBetweenSheetsWhenTheOperatorStopsThem) {
  choice.SheetSelection = SheetSelection::All;
  choice.OutputTarget = OutputTarget::Files;
  progress.StopAtSheet = 3;
  Run();
  EXPECT_THAT(word.Documents, SizeIs(3));
  EXPECT_TRUE(Sheet(2).Closed);
  EXPECT_THAT(word.Log.back(), StartsWith("JoinPdfs 3"));
  EXPECT_THAT(venue.Boxes.Boxes, ElementsAre(Closing("Printing stopped. 3 of 224 sheets have been made. "
                                                     "Files saved to /data/scores.")));
}

TEST_F(Sheets, SayThatTheyWereStoppedOnTheirWayToThePrinterToo) {
  progress.StopAtSheet = 1;
  Run();
  EXPECT_EQ(Sheet(0).Printed, 1);
  EXPECT_THAT(venue.Boxes.Boxes, ElementsAre(Closing("Printing stopped. 1 of 2 sheets have been made.")));
}

TEST_F(Sheets, AreCompleteWhenTheLastOneWasStopped) {
  progress.StopAtSheet = 2;
  Run();
  EXPECT_THAT(word.Documents, SizeIs(2));
  EXPECT_THAT(venue.Boxes.Boxes, ElementsAre(Completed));
}

TEST_F(Sheets, NameNoFolderWhenTheyWereStoppedBeforeTheFirst) {
  choice.OutputTarget = OutputTarget::Files;
  word.AfterStart = WordState::Starting;
  events.At(std::chrono::milliseconds(500), [this] { progress.Stop(); });
  Run();
  EXPECT_LT(events.Now(), std::chrono::seconds(2));
  EXPECT_THAT(word.Documents, IsEmpty());
  EXPECT_THAT(venue.Boxes.Boxes, ElementsAre(Closing("Printing stopped. 0 of 2 sheets have been made.")));
}

TEST_F(Sheets, NameTheirFolderWhenThereIsNoneToMake) {
  choice.SheetSelection = SheetSelection::OnePlayer;
  choice.SelectedTeam = 3;
  choice.SelectedNumber = 40;
  choice.OutputTarget = OutputTarget::Files;
  Run();
  EXPECT_THAT(venue.Boxes.Boxes, ElementsAre(Closing("Printing completed. Files saved to /data/scores.")));
}

TEST_F(Sheets, EndWithoutABoxWhenTheProgramCloses) {
  word.OnOperation = [this](const std::string& operation) {
    if (operation == "WriteCells 4") {
      events.EndWaits();
    }
  };
  Run();
  EXPECT_THAT(word.Documents, SizeIs(1));
  EXPECT_EQ(word.Log.back(), "WriteCells 4");
  EXPECT_EQ(progress.Log.back(), "Close");
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
}

TEST_F(Sheets, ServeEventsWithinEachSheet) {
  venue.game.Players(40).Active = false;
  std::vector<std::string> seen;
  for (const char* operation :
       {"Add /", "SetBookmark PlayerID", "SetBookmark ClanName", "WriteCells 4", "SaveAs"}) {
    seen.clear();
    word.Log.clear();
    bool served = false;
    word.OnOperation = [&](const std::string& now) {
      if (now.rfind(operation, 0) == 0) {
        events.At(std::chrono::milliseconds(0), [&] { served = true; });
      } else if (served) {
        seen.push_back(now);
        served = false;
      }
    };
    Run();
    EXPECT_THAT(seen, SizeIs(1)) << operation;
  }
}

TEST_F(Sheets, TellWhatTheyHaveMade) {
  Run();
  EXPECT_EQ(made.Folder, "/data/scores");
  EXPECT_EQ(made.Pdf, "");  // for the printer
  choice.OutputTarget = OutputTarget::Files;
  Run();
  EXPECT_EQ(made.Folder, "/data/scores");
  EXPECT_EQ(made.Pdf, "/data/scores/Score sheets-21 May 2013-Sniper Hunt.pdf");
  word.FailAt = "JoinPdfs";
  Run();
  EXPECT_EQ(made.Folder, "/data/scores");
  EXPECT_EQ(made.Pdf, "");
  word.FailAt = "SaveAs";
  Run();
  EXPECT_EQ(made.Folder, "");
}

TEST_F(Sheets, EnlargeTheirHitsWhereThereAreFew) {
  venue.game.Players(40).HitByPlayer(1) = 30;
  for (int victim = 1; victim <= 21; ++victim) {
    venue.game.Players(victim).HitByPlayer(40) = 10;
  }
  Run();
  ASSERT_TRUE(Sheet(0).Sizes.contains(4));
  EXPECT_EQ(Sheet(0).Sizes.at(4).Used, 1);
  EXPECT_GT(Sheet(0).Sizes.at(4).Letters, 1.5);
  EXPECT_FALSE(Sheet(1).Sizes.contains(4));  // 21 hits
  EXPECT_TRUE(Sheet(1).Sizes.contains(5));
}

TEST_F(Sheets, AreMadeInSmallLettersWhereTheTemplateDoesNotAllowOthers) {
  venue.game.Players(40).HitByPlayer(1) = 30;
  word.FailAt = "ResizeRows";
  Run();
  EXPECT_THAT(venue.Boxes.Boxes, ElementsAre(Completed));
  EXPECT_THAT(Sheet(0).Cells.at(4), SizeIs(1));
}

}  // namespace
