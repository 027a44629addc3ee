#include "sheets/ScoreSheets.h"

#include <gmock/gmock.h>

#include <algorithm>

#include "tests/fakes/FakeClock.h"
#include "tests/fakes/FakeEventPump.h"
#include "tests/fakes/FakeFiles.h"
#include "tests/fakes/FakeSheetProgress.h"
#include "tests/fakes/FakeWordProcessor.h"
#include "tests/support/ScoredGame.h"

namespace {

using testing::Contains;
using testing::ElementsAre;
using testing::IsEmpty;
using testing::Not;
using testing::Pair;
using testing::SizeIs;
using testing::StartsWith;
using Box = FakeMessageBoxes::Box;

/// The box after a run that did not fail.
Box Closing(const std::string& text) {
  return {text, "Print Status", BoxIcon::Information, BoxButtons::Ok};
}

const Box Completed = Closing("Printing completed.");

const std::string WithoutPdf =
    "Printing completed. Files saved to /data/scores.\n\n"
    "The PDF of all sheets could not be made. The sheets themselves are saved.";

Box Failure(const std::string& text) {
  return {text, "Print Error", BoxIcon::Exclamation, BoxButtons::OkCancel};
}

/// A run with a game of Red 0 (a member with a photo) and Blue 7 (a guest).
class Sheets : public testing::Test {
 protected:
  Sheets() {
    ExecuteSql(venue.MembersFile(),
               "INSERT INTO Members (ContactID, FirstName, LastName, NickName, PhotographLength, Photograph) "
               "VALUES (3, 'Ann', 'Lee', 'Mole', 4, x'01020304'), (4, 'Bo', 'Ray', NULL, 0, NULL)");
    venue.Open();
    venue.Activate(1).MemberIndex = 3;
    venue.Activate(1).Rank = 2;
    venue.Activate(40).Rank = 1;
    venue.game.GameDate = "21/05/2013 14:30";
    files.AddFolder("/data");
    choice.SheetSelection = SheetSelection::Active;
    choice.OutputTarget = OutputTarget::Printer;
  }

  void Run() {
    const SheetParts parts{.Game = venue.game,
                           .RsMembers = *venue.RsMembers,
                           .Members = *venue.Members,
                           .Strings = venue.Strings,
                           .Time = clock,
                           .Events = events,
                           .Disk = files,
                           .Boxes = venue.Boxes,
                           .WordApp = word,
                           .UprightPicture = upright,
                           .Progress = progress,
                           .UserDataFolder = "/data",
                           .MissionName = mission};
    ScoreSheets(parts, choice).GenerateScoreSheets();
  }

  const FakeWordProcessor::Document& Sheet(std::size_t at) const { return *word.Documents.at(at); }

  /// The file names of the saved sheets.
  std::vector<std::string> Names() const {
    std::vector<std::string> names;
    for (const auto& document : word.Documents) {
      names.push_back(document->SavedAs);
    }
    return names;
  }

  /// Expects the run to end when `operation` fails, with `text`, leaving the current sheet as it is.
  void ExpectFailure(const std::string& operation, const std::string& text) {
    word.FailAt = operation;
    Run();
    EXPECT_THAT(venue.Boxes.Boxes, ElementsAre(Failure(text))) << operation;
    EXPECT_EQ(progress.Log.back(), "Close");
  }

  ScoredGame venue;
  FakeClock clock;
  FakeEventPump events;
  FakeFiles files;
  FakeWordProcessor word;
  FakeSheetProgress progress;
  std::function<std::string(const std::string&)> upright = [](const std::string& photo) { return photo; };
  PrintChoice choice;
  std::string mission = "Sniper Hunt";
};

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

TEST_F(Sheets, NeedTheWordProcessor) {
  ExpectFailure("Start", "Could not locate score template file.");
}

TEST_F(Sheets, NeedTheTemplate) {
  ExpectFailure("Add", "Could not locate score template file.");
  EXPECT_THAT(Names(), IsEmpty());
}

TEST_F(Sheets, NeedTheBookmarks) {
  ExpectFailure("SetBookmark ClanName", "Score Sheet is missing bookmark(s). Unable to print.");
  EXPECT_FALSE(Sheet(0).Closed);
}

TEST_F(Sheets, NeedTableFour) {
  ExpectFailure("WriteCells 4", "Score Sheet is missing bookmark(s). Unable to print.");
}

TEST_F(Sheets, NeedTableFive) {
  ExpectFailure("WriteCells 5", "Score Sheet is missing bookmark(s). Unable to print.");
}

TEST_F(Sheets, NeedAPhotoThatIsAPicture) {
  ExpectFailure("AddPicture", "Error occured getting Memmber photo.");
}

TEST_F(Sheets, NeedATemporaryFileForThePhoto) {
  files.FailCreateFolder(FakeFiles::TempFolder, RuntimeError(75));
  ExpectFailure("-", "Error occured getting Memmber photo.");
}

TEST_F(Sheets, NeedThePhotosFileDeleted) {
  files.FailDelete("/tmp/per1", RuntimeError(70));
  ExpectFailure("-", "Error occured getting Memmber photo.");
}

TEST_F(Sheets, NeedTheirFolder) {
  files.FailCreateFolder("/data/scores", RuntimeError(75));
  ExpectFailure("-", "Failed to create sub folder for score saving.");
}

TEST_F(Sheets, NeedToBeSaved) {
  ExpectFailure("SaveAs", "Error occured during file saving.");
}

TEST_F(Sheets, DoNotNeedTheirPdf) {
  choice.OutputTarget = OutputTarget::Files;
  word.FailAt = "ExportPdf";
  Run();
  EXPECT_THAT(Names(), ElementsAre("/data/scores/Red 0-Ann Lee-21 May 2013-Sniper Hunt.doc",
                                   "/data/scores/Blue 7-Guest-21 May 2013-Sniper Hunt.doc"));
  EXPECT_TRUE(Sheet(1).Closed);
  EXPECT_EQ(std::count(word.Log.begin(), word.Log.end(), "ExportPdf"), 1);
  EXPECT_EQ(word.Log.back(), "Close");  // a PDF of some of the sheets is not made
  EXPECT_THAT(venue.Boxes.Boxes, ElementsAre(Closing(WithoutPdf)));
  EXPECT_THAT(files.Contents(), IsEmpty());
}

TEST_F(Sheets, DoNotNeedATemporaryFileForThePdf) {
  choice.OutputTarget = OutputTarget::Files;
  venue.game.Players(1).MemberIndex = 0;  // a photo needs one
  files.FailCreateFolder(FakeFiles::TempFolder, RuntimeError(75));
  Run();
  EXPECT_THAT(word.Documents, SizeIs(2));
  EXPECT_THAT(venue.Boxes.Boxes, ElementsAre(Closing(WithoutPdf)));
}

TEST_F(Sheets, DoNotNeedThePdfOfAll) {
  choice.OutputTarget = OutputTarget::Files;
  word.FailAt = "JoinPdfs";
  Run();
  EXPECT_THAT(word.Documents, SizeIs(2));
  EXPECT_THAT(venue.Boxes.Boxes, ElementsAre(Closing(WithoutPdf)));
  EXPECT_THAT(files.Contents(), IsEmpty());
}

TEST_F(Sheets, SayThatThePdfFailedWhenTheyWereStoppedToo) {
  choice.OutputTarget = OutputTarget::Files;
  progress.StopAtSheet = 1;
  word.FailAt = "JoinPdfs";
  Run();
  EXPECT_THAT(
      venue.Boxes.Boxes,
      ElementsAre(Closing("Printing stopped. 1 of 2 sheets have been made. "
                          "Files saved to /data/scores.\n\n"
                          "The PDF of all sheets could not be made. The sheets themselves are saved.")));
}

TEST_F(Sheets, EndWithTheirBoxWhenATemporaryPageCannotBeDeleted) {
  choice.OutputTarget = OutputTarget::Files;
  files.FailDelete("/tmp/per2", RuntimeError(70));  // per1 is the photo
  Run();
  EXPECT_THAT(venue.Boxes.Boxes, ElementsAre(Closing("Printing completed. Files saved to /data/scores.")));
  EXPECT_THAT(files.Contents(), ElementsAre(Pair("/tmp/per2", "")));
}

TEST_F(Sheets, TellTheirFailureWhenATemporaryPageCannotBeDeleted) {
  choice.OutputTarget = OutputTarget::Files;
  files.FailDelete("/tmp/per2", RuntimeError(70));
  word.FailAt = "Close";
  Run();
  EXPECT_THAT(venue.Boxes.Boxes, ElementsAre(Failure("Error occured during printing.")));
}

TEST_F(Sheets, NeedThePrinter) {
  ExpectFailure("PrintOut", "Error occured during printing.");
  EXPECT_THAT(word.Documents, SizeIs(1));
}

TEST_F(Sheets, NeedToBeClosed) {
  ExpectFailure("Close", "Error occured during printing.");
}

TEST_F(Sheets, CannotHaveANameThatSomeSystemRefuses) {
  for (const std::string part : {":", "/", "\\", "*", "?", "\"", "<", ">", "|", "\n", "\x1F", "\x7F"}) {
    venue.Boxes.Boxes.clear();
    word.Documents.clear();
    mission = "Hunt" + part;
    Run();
    EXPECT_THAT(venue.Boxes.Boxes, ElementsAre(Failure("Error occured during file saving."))) << part;
    EXPECT_THAT(Names(), ElementsAre("")) << part;
  }
}

TEST_F(Sheets, CannotBeOfAGameWithoutADate) {
  venue.game.GameDate = "N/A";
  Run();
  EXPECT_THAT(venue.Boxes.Boxes, ElementsAre(Failure("Error occured during file saving.")));
}

TEST_F(Sheets, CannotHaveALongerNameThanFileSystemsTake) {
  const std::string rest = "Red 0-Ann Lee-21 May 2013-.doc";
  venue.game.Players(40).Active = false;
  mission = std::string(255 - rest.size(), 'm');
  Run();
  EXPECT_THAT(venue.Boxes.Boxes, ElementsAre(Completed));
  mission += 'm';
  venue.Boxes.Boxes.clear();
  Run();
  EXPECT_THAT(venue.Boxes.Boxes, ElementsAre(Failure("Error occured during file saving.")));
}

}  // namespace
