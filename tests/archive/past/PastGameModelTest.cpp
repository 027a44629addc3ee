#include "archive/past/PastGameModel.h"

#include <gmock/gmock.h>

#include <QTableView>

#include "archive/past/PastMonthModel.h"
#include "platform/RuntimeError.h"
#include "tests/support/Controls.h"

namespace {

using testing::ElementsAre;
using testing::IsEmpty;

class ListOfPastGames : public testing::Test {
 protected:
  void Show(std::int64_t count) {
    std::vector<std::int64_t> games;
    for (std::int64_t game = count; game >= 1; --game) {
      games.push_back(game);
    }
    model.Show(std::move(games));
  }

  std::optional<ListedGame> Read(std::int64_t game) {
    reads.push_back(game);
    if (fails) {
      throw RuntimeError(Fault::DatabaseLocked, "locked");
    }
    if (game == gone) {
      return std::nullopt;
    }
    return ListedGame{.GameId = game,
                      .Played = "2026-11-21 20:15:30",
                      .DateText = "",
                      .Mission = "Flag",
                      .Players = 12,
                      .TeamTotals = {-4, 250, 0},
                      .BestPlayer = game == 1 ? 0 : 40,
                      .BestMember = game == 2 ? 5 : 0,
                      .BestSoldiering = 123,
                      .Pulls = 2,
                      .Committed = 3};
  }

  std::vector<std::string> Cells(int row) const {
    std::vector<std::string> cells;
    for (int column = 1; column < model.columnCount(); ++column) {
      cells.push_back(model.index(row, column).data().toString().toStdString());
    }
    return cells;
  }

  const StringTable strings{Language::English};
  std::vector<std::int64_t> reads;
  std::vector<std::string> failures;
  bool fails = false;
  std::int64_t gone = 0;
  PastGameModel model{
      {.Read = [this](std::int64_t game) { return Read(game); },
       .NickNameOf = [](std::int32_t member) { return "Member \t" + std::to_string(member); },
       .GuestNameOf = [](std::int64_t game, int index) { return game == 4 && index == 40 ? "Ann" : ""; },
       .Failed = [this](const std::string& reason) { failures.push_back(reason); }},
      strings};
};

TEST_F(ListOfPastGames, TellsAGame) {
  Show(3);
  EXPECT_THAT(Cells(0), ElementsAre("Flag", "12", "-4", "250", "0", "Blue 7, 123", "2", "3"));
  EXPECT_EQ(Cells(1)[5], "Member 5, 123");
  EXPECT_EQ(Cells(2)[5], "");
  Show(4);
  EXPECT_EQ(Cells(0)[5], "Ann, 123");
  EXPECT_EQ(model.index(0, 0).data().toString(), PastGameModel::TimeText("2026-11-21 20:15:30"));
  EXPECT_EQ(PastGameModel::TimeText("some day"), QStringLiteral("some day"));
}

TEST_F(ListOfPastGames, HasACaptionForEachColumn) {
  QStringList captions;
  for (int column = 0; column < model.columnCount(); ++column) {
    captions << model.headerData(column, Qt::Horizontal).toString();
  }
  EXPECT_EQ(captions.join(u'|').toStdString(),
            "Time|Mission|Players|Red|Blue|Yellow|Best player|Pulls|Committed");
}

TEST_F(ListOfPastGames, ReadsOnlyWhatIsInView) {
  Show(100'000);
  QTableView view;
  view.setModel(&model);
  view.resize(600, 400);
  ::Show(view);
  EXPECT_LT(reads.size(), 40U);
  view.scrollToBottom();
  view.repaint();
  QTest::qWait(0);
  EXPECT_LT(reads.size(), 80U);
  EXPECT_THAT(reads, testing::Contains(1));
}

TEST_F(ListOfPastGames, ReadsARowOnceUntilItIsShownAnew) {
  Show(3);
  Cells(0);
  Cells(0);
  EXPECT_THAT(reads, ElementsAre(3));
  Show(3);
  Cells(0);
  EXPECT_THAT(reads, ElementsAre(3, 3));
}

TEST_F(ListOfPastGames, KeepsOnlySomeOfTheRowsThatItHasRead) {
  Show(2500);
  for (int row = 0; row < 2500; ++row) {
    model.GameIn(row);
  }
  reads.clear();
  model.GameIn(2499);
  EXPECT_THAT(reads, IsEmpty());
  model.GameIn(0);
  EXPECT_THAT(reads, ElementsAre(2500));
}

TEST_F(ListOfPastGames, LeavesAGameThatHasGoneEmpty) {
  gone = 3;
  Show(3);
  EXPECT_THAT(Cells(0), testing::Each(""));
  EXPECT_EQ(model.GameIn(0), nullptr);
  EXPECT_THAT(failures, IsEmpty());
}

TEST_F(ListOfPastGames, TellsAFailureOnceAndTriesAgainWhenItIsShownAnew) {
  fails = true;
  Show(3);
  EXPECT_THAT(Cells(0), testing::Each(""));
  EXPECT_THAT(Cells(1), testing::Each(""));
  EXPECT_THAT(failures, ElementsAre("locked"));
  EXPECT_EQ(reads.size(), 1U);
  fails = false;
  Show(3);
  EXPECT_EQ(Cells(0)[0], "Flag");
}

TEST_F(ListOfPastGames, FindsTheRowOfAGame) {
  Show(3);
  EXPECT_EQ(model.RowOf(3), 0);
  EXPECT_EQ(model.RowOf(1), 2);
  EXPECT_EQ(model.RowOf(9), -1);
}

TEST(ListOfMonths, CountsTheGamesAndKeepsItsPlace) {
  const StringTable strings(Language::English);
  PastMonthModel model(strings);
  EXPECT_EQ(model.rowCount(), 2);
  EXPECT_EQ(model.RowOf({ListedPast::Month}), 0);
  model.Show({{"2026-12", 3}, {"2026-11", 4}});
  const auto text = [&model](int row, int column) { return model.index(row, column).data().toString(); };
  EXPECT_EQ(text(0, 0), QStringLiteral("All games"));
  EXPECT_EQ(text(0, 1), QStringLiteral("7"));
  EXPECT_EQ(text(2, 0), QStringLiteral("2026-11"));
  EXPECT_EQ(text(2, 1), QStringLiteral("4"));
  EXPECT_EQ(text(3, 0), QStringLiteral("Deleted"));
  EXPECT_EQ(text(3, 1), QString());
  EXPECT_EQ(model.RowOf({ListedPast::Month, "2026-11"}), 2);
  EXPECT_EQ(model.RowOf({ListedPast::Month, "2020-01"}), 1);
  EXPECT_EQ(model.RowOf({ListedPast::All}), 0);
  EXPECT_EQ(model.RowOf({ListedPast::Deleted}), 3);
}

}  // namespace
