#pragma once

#include <gmock/gmock.h>

#include <functional>
#include <string>
#include <vector>

#include "sheets/ScoreSheets.h"
#include "tests/fakes/FakeClock.h"
#include "tests/fakes/FakeEventPump.h"
#include "tests/fakes/FakeFiles.h"
#include "tests/fakes/FakeSheetProgress.h"
#include "tests/fakes/FakeWordProcessor.h"
#include "tests/support/ScoredGame.h"

/// The box after a run that did not fail.
inline FakeMessageBoxes::Box Closing(const std::string& text) {
  return {text, "Print Status", BoxIcon::Information, BoxButtons::Ok};
}

inline const FakeMessageBoxes::Box Completed = Closing("Printing completed.");

inline FakeMessageBoxes::Box Failure(const std::string& text) {
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
    made = ScoreSheets(parts, choice).GenerateScoreSheets();
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
    EXPECT_THAT(venue.Boxes.Boxes, testing::ElementsAre(Failure(text))) << operation;
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
  SheetFiles made;  ///< by the last run
};
