#include <gmock/gmock.h>

#include <QTableView>
#include <QToolButton>

#include "devices/radio/RemoteManage.h"
#include "tests/app/AnsweringRed1.h"
#include "tests/support/WhileModal.h"

namespace {

using testing::ElementsAre;

/// The window as the program opens it.
class RemoteCommand : public testing::Test {
 protected:
  RemoteCommand() { venue.Start(); }

  Venue venue;
  AnsweringRed1 gun{venue};
};

TEST_F(RemoteCommand, OpensTheWindowByMenuAndButton) {
  const auto closeAtOnce = [](RemoteManage& window) {
    EXPECT_TRUE(window.isModal());
    ::Press(window, "Close");
  };
  const WhileModal<RemoteManage> byMenu(closeAtOnce);
  venue.Trigger("mnuRemoteManage");
  EXPECT_EQ(byMenu.Runs(), 1);
  const WhileModal<RemoteManage> byButton(closeAtOnce);
  venue.Press("RemoteManageButton");
  EXPECT_EQ(byButton.Runs(), 1);
}

TEST_F(RemoteCommand, RecalculatesTheBoardAfterwards) {
  EXPECT_EQ(venue.RowCount("TeamScores"), 0);
  const WhileModal<RemoteManage> window([this](RemoteManage& remote) {
    venue.Port.OnOutput = [this](std::uint8_t byte) { gun.Hear(byte); };
    ::Press(remote, "SearchGunsButton");
    ::Press(remote, "GetScoresButton");
    remote.close();
  });
  venue.Press("RemoteManageButton");
  EXPECT_EQ(window.Runs(), 1);
  EXPECT_THAT(venue.Column("ScoreDisplay", 1), ElementsAre("Red  1"));
  EXPECT_EQ(venue.RowCount("TeamScores"), 3);
}

TEST_F(RemoteCommand, TellsTheStatusLineWhichGunsItCountedTwice) {
  venue.LoadGame(GameFile(PlayerOf(2) + PlayerOf(40)));
  const WhileModal<RemoteManage> window([this](RemoteManage& remote) {
    venue.Port.OnOutput = [this](std::uint8_t byte) { gun.Hear(byte); };
    ::Press(remote, "SearchGunsButton");
    ::Press(remote, "GetScoresButton");
    remote.close();
  });
  venue.Press("RemoteManageButton");
  EXPECT_EQ(venue.Find<QToolButton>("DeskCountedTwiceLink").text(), QStringLiteral("Guns counted twice: 1"));
}

TEST_F(RemoteCommand, RecalculatesTheBoardAlsoWithoutAGame) {
  ASSERT_EQ(venue.RowCount("TeamScores"), 0);
  const WhileModal<RemoteManage> window([](RemoteManage& remote) { remote.close(); });
  venue.Trigger("mnuRemoteManage");
  EXPECT_EQ(window.Runs(), 1);
  EXPECT_EQ(venue.RowCount("TeamScores"), 3);
}

TEST_F(RemoteCommand, StartsWithAnEmptyListEachTime) {
  for (int i = 0; i < 2; ++i) {
    const WhileModal<RemoteManage> window([](RemoteManage& remote) {
      EXPECT_EQ(::Find<QTableView>(remote, "DataList").model()->rowCount(), 0);
      remote.close();
    });
    venue.Trigger("mnuRemoteManage");
    EXPECT_EQ(window.Runs(), 1);
  }
}

TEST_F(RemoteCommand, LeavesTheLineToTheBaseUnitAtItsOwnSpeed) {
  const WhileModal<RemoteManage> window([](RemoteManage& remote) {
    ::Press(remote, "GetScoresButton");
    remote.close();
  });
  venue.Trigger("mnuRemoteManage");
  venue.Port.OnOutput = [this](std::uint8_t byte) {
    if (byte == 0) {
      venue.Port.Receive({0});
    }
  };
  venue.Press("GetScores");
  EXPECT_THAT(venue.Port.Log, ElementsAre("Open /dev/ttyS0 57600,N,8,1", "Close",
                                          "Open /dev/ttyS0 19200,N,8,1", "Output 1", "Output 0", "Close"));
}

}  // namespace
