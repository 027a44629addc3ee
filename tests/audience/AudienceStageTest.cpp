#include "audience/AudienceStage.h"

#include <gtest/gtest.h>

#include <QBuffer>
#include <QSignalSpy>

namespace {

class Stage : public testing::Test {
 protected:
  Stage() {
    state.TurnOn();
    stage.SetRunning(true);
  }

  void PutPlayers(int players) {
    game = {};
    for (int place = 1; place <= players; ++place) {
      game.Players.push_back({.Place = place, .Index = place, .Team = 1, .PublicName = "Name"});
    }
    game.Totals.push_back({1, 100});
  }

  StringTable strings{Language::English};
  AudienceResults game;
  AudienceState state{[this] { return game; }, [this] { stage.Begin(); }};
  AudienceStage stage{state, strings};
};

TEST_F(Stage, PaintsOnlyWhenSomethingHasChanged) {
  const qint64 first = stage.Picture().cacheKey();
  EXPECT_EQ(stage.Picture().cacheKey(), first);
  state.ShowBlank();
  EXPECT_NE(stage.Picture().cacheKey(), first);
}

TEST_F(Stage, IsBlackWhileBlank) {
  state.ShowBlank();
  const QImage picture = stage.Picture();
  QImage black(picture.size(), picture.format());
  black.fill(Qt::black);
  EXPECT_EQ(picture, black);
}

TEST_F(Stage, HasOneTurnForOnePage) {
  PutPlayers(5);
  state.ShowResults();
  EXPECT_EQ(stage.Turn().View, AudienceView::Results);
  EXPECT_EQ(stage.Turns(), 1);
  EXPECT_FALSE(stage.IsTurning());
}

TEST_F(Stage, TurnsPagesAndComesBackToTheFirst) {
  AudienceSetup setup;
  setup.Metres = 12;
  stage.SetSetup(setup, {});
  PutPlayers(60);
  state.ShowResults();
  ASSERT_GT(stage.Turns(), 1);
  EXPECT_TRUE(stage.IsTurning());
  QSignalSpy changed(&stage, &AudienceStage::PictureChanged);
  for (int turn = 1; turn <= stage.Turns(); ++turn) {
    stage.ShowNext();
    EXPECT_EQ(stage.Turn().Page, turn % stage.Turns());
  }
  EXPECT_EQ(changed.count(), stage.Turns());
}

TEST_F(Stage, StandsStillWhileNobodyLooks) {
  AudienceSetup setup;
  setup.Metres = 12;
  stage.SetSetup(setup, {});
  PutPlayers(60);
  state.ShowResults();
  stage.SetRunning(false);
  EXPECT_FALSE(stage.IsTurning());
}

TEST_F(Stage, ShowsTheAddressAtATurnOfItsOwn) {
  PutPlayers(5);
  state.SetAddress("http://192.168.1.20:8080");
  state.ShowResults();
  ASSERT_EQ(stage.Turns(), 4);
  const QImage results = stage.Picture();
  for (int turn = 0; turn < 3; ++turn) {
    stage.ShowNext();
  }
  EXPECT_EQ(stage.Turn().View, AudienceView::Phone);
  EXPECT_NE(stage.Picture(), results);
}

TEST_F(Stage, ShowsThePictureOfTheVenue) {
  const QImage before = stage.Picture();
  QImage venue(64, 48, QImage::Format_RGB32);
  venue.fill(QColor(10, 200, 30));
  stage.SetSetup({}, venue);
  const QImage picture = stage.Picture();
  EXPECT_NE(picture, before);
  EXPECT_EQ(picture.pixelColor(picture.width() / 2, picture.height() / 2), QColor(10, 200, 30));
}

TEST_F(Stage, CountsTheGunsThatComeIn) {
  state.BeginPull();
  state.TellReceived(1, 12);
  const QImage one = stage.Picture();
  state.TellReceived(2, 12);
  EXPECT_NE(stage.Picture(), one);
}

TEST(VenuePicture, IsNoneWhereTheFileIsNone) {
  EXPECT_TRUE(ReadVenuePicture("no picture").isNull());
  EXPECT_TRUE(ReadVenuePicture({}).isNull());
}

TEST(VenuePicture, IsNoLargerThanAScreen) {
  QImage large(6000, 300, QImage::Format_RGB32);
  large.fill(Qt::red);
  QByteArray bytes;
  QBuffer buffer(&bytes);
  large.save(&buffer, "PNG");
  EXPECT_EQ(ReadVenuePicture(bytes.toStdString()).size(), QSize(3840, 192));
}

}  // namespace
