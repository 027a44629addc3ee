#include "core/game/BoardTexts.h"

#include <gmock/gmock.h>

#include <utility>

namespace {

using testing::ElementsAre;

BoardRow RowOf(int index) {
  return {.Index = index, .Team = TeamFromId(IdFromIndex(index))};
}

class TextsOfTheBoard : public testing::Test {
 protected:
  std::vector<std::string> Cells(const BoardRow& row, int columns = BoardColumnCount) const {
    std::vector<std::string> cells;
    for (int column = 0; column < columns; ++column) {
      cells.push_back(texts.Cell(row, static_cast<BoardColumn>(column)));
    }
    return cells;
  }

  StringTable strings{Language::English};
  Game game{strings};
  BoardTexts texts{game, strings};
};

TEST_F(TextsOfTheBoard, ShowEachFigureInItsColumn) {
  const BoardRow row{.Index = 40,
                     .Team = 2,
                     .Rank = 7,
                     .MemberName = "Mole",
                     .Soldiering = -289,
                     .Accuracy = 0.5F,
                     .Damage = 240,
                     .ShotsFired = 60,
                     .Wia = 1,
                     .Kia = 3,
                     .AmmoAdds = 2};
  EXPECT_THAT(Cells(row),
              ElementsAre("7", "Blue  7: Mole", "-289", "50.00%", " 240", " 60", " 1", " 3", " 2"));
}

TEST_F(TextsOfTheBoard, NameEveryPlayerByTeamAndNumber) {
  for (int index = 1; index <= PlayerCount; ++index) {
    EXPECT_EQ(texts.Name(RowOf(index)), game.DisplayName(index));
    EXPECT_EQ(texts.Cell(RowOf(index), BoardColumn::Player), game.DisplayName(index));
  }
  EXPECT_EQ(texts.Name(RowOf(105)), "Red  40");
}

TEST_F(TextsOfTheBoard, LeaveTheMemberOutOfTheName) {
  BoardRow row = RowOf(1);
  row.MemberName = "A: 9";
  EXPECT_EQ(texts.Name(row), "Red  0");
  EXPECT_EQ(texts.Cell(row, BoardColumn::Player), "Red  0: A: 9");
}

TEST_F(TextsOfTheBoard, ShowATeamInThreeColumns) {
  EXPECT_THAT(Cells({.Team = 3, .Rank = 1, .Soldiering = -11}, TeamColumnCount),
              ElementsAre("1", "Yellow", "-11"));
}

TEST_F(TextsOfTheBoard, SayWhyThereIsNoAccuracyInEachLanguage) {
  BoardRow row = RowOf(1);
  const StringTable chinese(Language::SimplifiedChinese);
  const BoardTexts inChinese(game, chinese);
  row.HasAccuracy = AccuracyKind::NoPrimaryDamage;
  EXPECT_EQ(texts.Cell(row, BoardColumn::Accuracy), "Error");
  EXPECT_EQ(inChinese.Cell(row, BoardColumn::Accuracy), "错误");
  row.HasAccuracy = AccuracyKind::NoShots;
  EXPECT_EQ(texts.Cell(row, BoardColumn::Accuracy), "N/A");
  EXPECT_EQ(inChinese.Cell(row, BoardColumn::Accuracy), "N/A");
}

TEST_F(TextsOfTheBoard, HeadTheColumnsOfBothLists) {
  std::vector<std::string> players;
  for (int column = 0; column < BoardColumnCount; ++column) {
    players.push_back(texts.Header(BoardList::Players, static_cast<BoardColumn>(column)));
  }
  EXPECT_THAT(players, ElementsAre("Rank", "Player", "Soldiering", "Accuracy", "Damage", "Shots Fired",
                                   "W.I.A.", "K.I.A.", "Ammo Adds"));
  std::vector<std::string> teams;
  for (int column = 0; column < TeamColumnCount; ++column) {
    teams.push_back(texts.Header(BoardList::Teams, static_cast<BoardColumn>(column)));
  }
  EXPECT_THAT(teams, ElementsAre("Rank", "Team", "Soldiering"));
}

TEST_F(TextsOfTheBoard, ExplainTheColumns) {
  EXPECT_EQ(texts.HeaderTip(BoardList::Players, BoardColumn::Wia), "W.I.A.: times healed");
  const StringTable chinese(Language::SimplifiedChinese);
  for (const StringTable* table : {&std::as_const(strings), &chinese}) {
    const BoardTexts tips(game, *table);
    for (const BoardList list : {BoardList::Players, BoardList::Teams}) {
      const int columns = list == BoardList::Players ? BoardColumnCount : TeamColumnCount;
      for (int column = 0; column < columns; ++column) {
        const std::string header = tips.Header(list, static_cast<BoardColumn>(column));
        const std::string tip = tips.HeaderTip(list, static_cast<BoardColumn>(column));
        EXPECT_EQ(tip.substr(0, header.size()), header);
        EXPECT_GT(tip.size(), header.size() + 4);
      }
    }
  }
}

TEST_F(TextsOfTheBoard, NameAPlayerWithTheMemberOnTheBoard) {
  Board players{[] {}};
  BoardRow row = RowOf(40);
  row.MemberName = "Mole";
  players.AddRow(std::move(row));
  EXPECT_EQ(PlayerText(40, players, game, texts), "Blue  7: Mole");
  EXPECT_EQ(PlayerText(1, players, game, texts), "Red  0");
}

}  // namespace
