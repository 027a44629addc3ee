#include <gmock/gmock.h>

#include <QLabel>
#include <QRadioButton>
#include <QToolButton>

#include "sheets/PrintOptions.h"
#include "tests/support/Venue.h"
#include "tests/support/WhileModal.h"

namespace {

using testing::Contains;
using testing::ElementsAre;
using testing::IsEmpty;
using testing::SizeIs;
using Box = FakeMessageBoxes::Box;

const Box WordMissing = {"Could not start Microsoft Word - score printing is disabled.",
                         "Microsoft Word Error", BoxIcon::Exclamation, BoxButtons::Ok};

class PrintScores : public testing::Test {
 protected:
  bool Offered() const { return venue.Find<QAction>("mnuPrintScores").isEnabled(); }

  /// Waits for the word processor's start to be noticed.
  bool Follow(const std::function<bool()>& condition) const { return QTest::qWaitFor(condition, 10000); }

  Venue venue;
};

TEST_F(PrintScores, WordProcessorIsStartedOnceTheWindowIsUp) {
  venue.Word.AfterStart = WordState::Starting;
  venue.PutDefaultFiles();
  venue.MakeWindow().FormLoad();
  EXPECT_THAT(venue.Word.Log, IsEmpty());
  venue.Window->show();
  ASSERT_TRUE(Follow([this] { return !venue.Word.Log.empty(); }));
  EXPECT_THAT(venue.Word.Log, ElementsAre("Start"));
  EXPECT_TRUE(Offered());
}

TEST_F(PrintScores, IsDisabledWithABoxWhenTheWordProcessorIsMissing) {
  venue.Word.FailAt = "Start";
  venue.Start();
  ASSERT_TRUE(Follow([this] { return !Offered(); }));
  EXPECT_THAT(venue.Boxes.Boxes, ElementsAre(WordMissing));
  EXPECT_TRUE(venue.Find<QAction>("mnuLoadScores").isEnabled());
}

TEST_F(PrintScores, IsDisabledWithABoxWhenTheWordProcessorEndsWhileItStarts) {
  venue.Word.AfterStart = WordState::Starting;
  venue.Start();
  ASSERT_TRUE(Follow([this] { return !venue.Word.Log.empty(); }));
  venue.Word.Now = WordState::Ended;
  ASSERT_TRUE(Follow([this] { return !Offered(); }));
  EXPECT_THAT(venue.Boxes.Boxes, ElementsAre(WordMissing));
}

TEST_F(PrintScores, WordProcessorIsQuitWhenTheWindowCloses) {
  venue.Start().close();
  EXPECT_THAT(venue.Word.Log, Contains("Quit"));
}

TEST_F(PrintScores, MakesTheSheetsThatWereChosenAndKeepsTheChoice) {
  venue.Start();
  venue.LoadGame(SmallGame());
  const WhileModal<PrintOptions> choose([](PrintOptions& window) {
    Find<QRadioButton>(window, "PrintFile").setChecked(true);
    window.accept();
  });
  venue.Trigger("mnuPrintScores");
  EXPECT_THAT(venue.Word.Documents, SizeIs(2));
  EXPECT_EQ(venue.Word.Documents[0]->SavedAs, venue.DataFile("scores/Red 0-Guest-today-None.doc"));
  EXPECT_THAT(venue.Boxes.Boxes,
              ElementsAre(Box{"Printing completed. Files saved to " + venue.DataFolder() + "/scores.",
                              "Print Status", BoxIcon::Information, BoxButtons::Ok}));
  EXPECT_EQ(QGuiApplication::overrideCursor(), nullptr);
  const WhileModal<PrintOptions> again([](PrintOptions& window) {
    EXPECT_TRUE(Find<QRadioButton>(window, "PrintFile").isChecked());
    window.reject();
  });
  venue.Trigger("mnuPrintScores");
  EXPECT_THAT(venue.Word.Documents, SizeIs(2));
}

TEST_F(PrintScores, LeavesLinksToWhatItMade) {
  venue.Start();
  venue.LoadGame(SmallGame());
  const auto& links = venue.Find<QLabel>("Sheets");
  EXPECT_FALSE(links.isVisible());
  const WhileModal<PrintOptions> choose([](PrintOptions& window) {
    Find<QRadioButton>(window, "PrintFile").setChecked(true);
    window.accept();
  });
  venue.Trigger("mnuPrintScores");
  EXPECT_TRUE(links.isVisible());
  venue.Find<QToolButton>("SheetFolderLink").click();
  venue.Find<QToolButton>("SheetPdfLink").click();
  EXPECT_THAT(venue.Started.Started,
              ElementsAre(ElementsAre("xdg-open", venue.DataFile("scores")),
                          ElementsAre("xdg-open", venue.DataFile("scores/Score sheets-today-None.pdf"))));
  EXPECT_THAT(venue.Boxes.Boxes, SizeIs(1));
  venue.Trigger("mnuClearScores");
  EXPECT_FALSE(links.isVisible());
}

TEST_F(PrintScores, LinksToNoPdfAfterPrinting) {
  venue.Start();
  venue.LoadGame(SmallGame());
  const WhileModal<PrintOptions> choose([](PrintOptions& window) { window.accept(); });
  venue.Trigger("mnuPrintScores");
  EXPECT_TRUE(venue.Find<QToolButton>("SheetFolderLink").isVisible());
  EXPECT_FALSE(venue.Find<QToolButton>("SheetPdfLink").isVisible());
}

TEST_F(PrintScores, SaysWithoutABoxThatNothingOpensTheFolder) {
  venue.Start();
  venue.LoadGame(SmallGame());
  const WhileModal<PrintOptions> choose([](PrintOptions& window) { window.accept(); });
  venue.Trigger("mnuPrintScores");
  venue.Started.Failure = RuntimeError(Fault::FileNotFound);
  venue.Find<QToolButton>("SheetFolderLink").click();
  EXPECT_EQ(venue.Find<QLabel>("Unopened").text().toStdString(),
            venue.DataFile("scores") + " could not be opened.");
  EXPECT_THAT(venue.Boxes.Boxes, SizeIs(1));
}

}  // namespace
