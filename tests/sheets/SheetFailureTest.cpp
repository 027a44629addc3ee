#include <algorithm>

#include "platform/RuntimeError.h"
#include "tests/sheets/SheetRun.h"

namespace {

using testing::ElementsAre;
using testing::IsEmpty;
using testing::Pair;
using testing::SizeIs;

const std::string WithoutPdf =
    "Printing completed. Files saved to /data/scores.\n\n"
    "The PDF of all sheets could not be made. The sheets themselves are saved.";

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
