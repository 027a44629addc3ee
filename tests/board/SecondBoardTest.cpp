#include <gmock/gmock.h>

#include <QAbstractItemModelTester>
#include <QHeaderView>
#include <QSignalSpy>
#include <memory>

#include "board/ScoreListModel.h"
#include "board/ScoreListView.h"
#include "tests/support/OpenSession.h"

// Several boards that show one session.

namespace {

using testing::ElementsAre;
using testing::IsEmpty;
using testing::Pair;

/// Both lists of the session on a screen.
struct Screen {
  Screen(Session& session, const StringTable& strings)
      : PlayerModel(session, BoardList::Players, strings, nullptr),
        TeamModel(session, BoardList::Teams, strings, nullptr) {
    PlayerView.setModel(&PlayerModel);
    TeamView.setModel(&TeamModel);
  }

  static std::vector<std::string> Column(const ScoreListModel& model, int column) {
    std::vector<std::string> cells;
    for (int row = 0; row < model.rowCount(); ++row) {
      cells.push_back(model.index(row, column).data().toString().toStdString());
    }
    return cells;
  }

  std::vector<std::string> Players() const { return Column(PlayerModel, 1); }
  std::vector<std::string> Teams() const { return Column(TeamModel, 1); }
  /// Rows of players and of teams that the views know of.
  std::pair<int, int> RowsSeen() const {
    return {PlayerView.verticalHeader()->count(), TeamView.verticalHeader()->count()};
  }

  ScoreListModel PlayerModel;
  ScoreListModel TeamModel;
  QAbstractItemModelTester PlayerTester{&PlayerModel, QAbstractItemModelTester::FailureReportingMode::Fatal};
  QAbstractItemModelTester TeamTester{&TeamModel, QAbstractItemModelTester::FailureReportingMode::Fatal};
  ScoreListView PlayerView;
  ScoreListView TeamView;
};

class SecondBoard : public testing::Test {
 protected:
  SecondBoard() {
    venue.Open();
    venue.Play(1, 5);
    venue.Play(40, 9);
  }

  std::unique_ptr<Screen> MakeScreen() { return std::make_unique<Screen>(venue.session, venue.Strings); }

  OpenSession venue;
};

TEST_F(SecondBoard, ShowsWhatTheFirstShows) {
  const auto first = MakeScreen();
  const auto second = MakeScreen();
  venue.session.CalculateScores();
  for (const auto* screen : {first.get(), second.get()}) {
    EXPECT_THAT(screen->Players(), ElementsAre("Blue  7", "Red  0"));
    EXPECT_THAT(screen->Teams(), ElementsAre("Blue", "Red", "Yellow"));
    EXPECT_THAT(screen->RowsSeen(), Pair(2, 3));
  }
  venue.session.SortByHeader(2);
  EXPECT_THAT(first->Players(), ElementsAre("Red  0", "Blue  7"));
  EXPECT_THAT(second->Players(), ElementsAre("Red  0", "Blue  7"));
  venue.session.ClearPlayerData();
  for (const auto* screen : {first.get(), second.get()}) {
    EXPECT_THAT(screen->Players(), IsEmpty());
    EXPECT_THAT(screen->Teams(), IsEmpty());
    EXPECT_THAT(screen->RowsSeen(), Pair(0, 0));
  }
}

TEST_F(SecondBoard, ShowsTheRowsThatAreThereWhenItComes) {
  venue.session.CalculateScores();
  const auto late = MakeScreen();
  EXPECT_THAT(late->Players(), ElementsAre("Blue  7", "Red  0"));
}

TEST_F(SecondBoard, LivesOnWhicheverOtherGoes) {
  auto first = MakeScreen();
  auto second = MakeScreen();
  auto third = MakeScreen();
  venue.session.CalculateScores();
  second.reset();
  venue.Play(65, 20);
  venue.session.CalculateScores();
  EXPECT_THAT(first->Players(), ElementsAre("Yellow  0", "Blue  7", "Red  0"));
  EXPECT_THAT(third->Players(), ElementsAre("Yellow  0", "Blue  7", "Red  0"));
  first.reset();
  venue.session.SortByHeader(2);
  EXPECT_THAT(third->Players(), ElementsAre("Red  0", "Blue  7", "Yellow  0"));
}

TEST_F(SecondBoard, IsToldOnceOfEachChange) {
  const auto first = MakeScreen();
  const auto second = MakeScreen();
  venue.session.CalculateScores();
  QSignalSpy resetsOfFirst(&first->PlayerModel, &QAbstractItemModel::modelReset);
  QSignalSpy resetsOfSecond(&second->PlayerModel, &QAbstractItemModel::modelReset);
  QSignalSpy resetsOfTeams(&second->TeamModel, &QAbstractItemModel::modelReset);
  venue.session.SortByHeader(3);
  EXPECT_EQ(resetsOfFirst.count(), 1);
  EXPECT_EQ(resetsOfSecond.count(), 1);
  EXPECT_EQ(resetsOfTeams.count(), 0);
}

TEST_F(SecondBoard, KeepsASelectionOfItsOwn) {
  const auto first = MakeScreen();
  const auto second = MakeScreen();
  venue.session.CalculateScores();
  first->PlayerView.selectRow(1);
  EXPECT_TRUE(first->PlayerView.selectionModel()->isRowSelected(1));
  EXPECT_FALSE(second->PlayerView.selectionModel()->hasSelection());
}

TEST_F(SecondBoard, MayComeAndGoWhileTheFirstIsBeingTold) {
  const auto first = MakeScreen();
  auto second = MakeScreen();
  std::unique_ptr<Screen> third;
  const Subscription audience = venue.session.Listen([&](SessionChange change) {
    if (change == SessionChange::PlayerRows) {
      second.reset();
      third = MakeScreen();
    }
  });
  venue.session.CalculateScores();
  EXPECT_THAT(first->Players(), ElementsAre("Blue  7", "Red  0"));
  EXPECT_THAT(third->Players(), ElementsAre("Blue  7", "Red  0"));
  EXPECT_THAT(third->Teams(), ElementsAre("Blue", "Red", "Yellow"));
}

TEST_F(SecondBoard, ShowsPlayerAndMemberApart) {
  ExecuteSql(venue.MembersFile(), "INSERT INTO Members (ContactID, NickName) VALUES (3, 'x: 9')");
  venue.session.Close();
  venue.Open();
  venue.session.Game().Players(40).MemberIndex = 3;
  const auto screen = MakeScreen();
  venue.session.CalculateScores();
  const QModelIndex member = screen->PlayerModel.index(0, 1);
  EXPECT_EQ(member.data().toString(), QStringLiteral("Blue  7: x: 9"));
  EXPECT_EQ(member.data(ScoreListModel::NameRole).toString(), QStringLiteral("Blue  7"));
  EXPECT_EQ(member.data(ScoreListModel::MemberNameRole).toString(), QStringLiteral("x: 9"));
  EXPECT_EQ(screen->PlayerModel.index(1, 1).data(ScoreListModel::MemberNameRole).toString(), QString());
}

}  // namespace
