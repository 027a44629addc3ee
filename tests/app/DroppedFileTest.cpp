#include <gmock/gmock.h>

#include <QDropEvent>
#include <QMimeData>
#include <QUrl>

#include "tests/support/Venue.h"

namespace {

using testing::ElementsAre;
using testing::IsEmpty;

class DroppedFile : public testing::Test {
 protected:
  DroppedFile() {
    venue.Start();
    WriteFile(venue.Folder / "dropped.xml", GameFile(PlayerOf(65), "Free For All"));
  }

  /// Drops files on the window. Returns true if it takes them.
  bool Drop(const std::vector<std::string>& paths) {
    if (!LetFall(paths)) {
      return false;
    }
    EXPECT_THAT(venue.Boxes.Boxes, IsEmpty()) << "the other program waits";
    QCoreApplication::processEvents();
    return true;
  }

  /// Does so, but the window has had no time for them yet.
  bool LetFall(const std::vector<std::string>& paths) {
    QMimeData data;
    QList<QUrl> urls;
    for (const std::string& path : paths) {
      urls.append(QUrl::fromLocalFile(QString::fromStdString(path)));
    }
    data.setUrls(urls);
    QDragEnterEvent enter(QPoint(50, 50), Qt::CopyAction, &data, Qt::LeftButton, {});
    enter.ignore();
    QApplication::sendEvent(venue.Window.get(), &enter);
    if (!enter.isAccepted()) {
      return false;
    }
    QDropEvent drop(QPointF(50, 50), Qt::CopyAction, &data, Qt::LeftButton, {});
    QApplication::sendEvent(venue.Window.get(), &drop);
    return drop.isAccepted();
  }

  std::string File() const { return venue.Folder / "dropped.xml"; }

  Venue venue;
};

TEST_F(DroppedFile, IsLoadedWithoutADialog) {
  EXPECT_TRUE(Drop({File()}));
  EXPECT_THAT(venue.Column("ScoreDisplay", 1), ElementsAre("Yellow  0"));
  EXPECT_EQ(venue.ActiveMission().currentIndex(), 1);
  EXPECT_THAT(venue.Dialog.Calls, IsEmpty());
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
}

TEST_F(DroppedFile, ReplacesASavedGameWithoutAQuestion) {
  venue.LoadGame(SmallGame());
  EXPECT_TRUE(Drop({File()}));
  EXPECT_THAT(venue.Column("ScoreDisplay", 1), ElementsAre("Yellow  0"));
}

TEST_F(DroppedFile, ReplacesAnUnsavedGameOnlyWhenTheOperatorWantsIt) {
  venue.LoadGame(SmallGame());
  venue.ActiveMission().setCurrentIndex(1);
  venue.Boxes.Answers = {BoxAnswer::Cancel, BoxAnswer::Ok};
  EXPECT_TRUE(Drop({File()}));
  EXPECT_EQ(venue.RowCount("ScoreDisplay"), 2);
  const FakeMessageBoxes::Box question{
      "The game on the board is not saved. Replace it with the game in dropped.xml?", "Tessarine",
      BoxIcon::Question, BoxButtons::OkCancel};
  EXPECT_THAT(venue.Boxes.Boxes, ElementsAre(question));
  venue.Boxes.Boxes.clear();
  EXPECT_TRUE(Drop({File()}));
  EXPECT_THAT(venue.Column("ScoreDisplay", 1), ElementsAre("Yellow  0"));
}

TEST_F(DroppedFile, MustBeOneFile) {
  EXPECT_FALSE(Drop({}));
  EXPECT_FALSE(Drop({File(), File()}));
  EXPECT_FALSE(Drop({venue.Folder.Path()}));
  EXPECT_FALSE(Drop({venue.Folder / "missing.xml"}));
  EXPECT_EQ(venue.RowCount("ScoreDisplay"), 0);
}

TEST_F(DroppedFile, IsRefusedWhileABoxIsOpenOrACommandRuns) {
  int boxes = 0;
  venue.Boxes.WhileOpen = [&](const auto& /*box*/) {
    ++boxes;
    EXPECT_FALSE(Drop({File()}));
  };
  venue.Boxes.Answers = {BoxAnswer::Cancel};
  venue.Trigger("mnuClearScores");
  EXPECT_EQ(boxes, 1);
  EXPECT_EQ(venue.RowCount("ScoreDisplay"), 0);
}

TEST_F(DroppedFile, IsForgottenWhenTheProgramEndsBeforeItIsLoaded) {
  EXPECT_TRUE(LetFall({File()}));
  venue.Window->close();
  QCoreApplication::processEvents();
  EXPECT_EQ(venue.RowCount("ScoreDisplay"), 0);
}

TEST_F(DroppedFile, IsTakenWhereverItFallsInTheWindow) {
  for (const QWidget* child : venue.Window->findChildren<QWidget*>()) {
    EXPECT_FALSE(child->acceptDrops()) << child->objectName().toStdString();
  }
}

TEST_F(DroppedFile, IsSavedToAsIfItHadBeenChosen) {
  EXPECT_TRUE(Drop({File()}));
  venue.Trigger("mnuSaveScores");
  EXPECT_EQ(venue.Dialog.Calls.back().Name, File());
}

}  // namespace
