#include "archive/past/PastBoard.h"

#include <gtest/gtest.h>

#include "core/game/BoardTexts.h"
#include "core/gamefile/GameFile.h"
#include "tests/support/OpenSession.h"
#include "tests/support/RandomGame.h"

namespace {

TEST(PastBoards, ShowEachCellAsTheBoardDid) {
  OpenSession venue;
  ExecuteSql(
      venue.MembersFile(),
      "INSERT INTO Members (ContactID, FirstName, LastName, NickName) VALUES (7, 'Bo', 'Ray', 'Mole'), "
      "(8, 'Cy', 'Fox', NULL)");
  ASSERT_TRUE(venue.Open());
  Session& session = venue.session;
  FillRandomly(session.Game(), 60, 5);
  int member = 7;
  for (Player& player : session.Game().Players) {
    if (!player.Active) {
      player.Clear();  // what game files do not tell
    } else if (member <= 8) {
      player.MemberIndex = member++;
    }
  }
  session.Game().DataPresent = true;
  session.CalculateScores();

  Game past(venue.Strings);
  ASSERT_TRUE(ReadGameFile(WriteGameFile(session.Game(), "None"), past, [](const std::string&) {}));
  Board board([] {});
  ListPastPlayers(
      past,
      [&session](std::int32_t contactId) {
        return session.Members().FindMember(contactId)->GetPlayerName(true);
      },
      board);
  const Board& before = session.List(BoardList::Players);
  const BoardTexts texts(past, venue.Strings);
  ASSERT_EQ(board.RowCount(), 60);
  for (int place = 0; place < board.RowCount(); ++place) {
    for (int column = 0; column < BoardColumnCount; ++column) {
      const auto which = static_cast<BoardColumn>(column);
      EXPECT_EQ(texts.Cell(board.RowAt(place), which), venue.Texts.Cell(before.RowAt(place), which))
          << place << ", " << column;
    }
  }
}

TEST(PastBoards, NameAPlayerByTheGunWhoseMemberIsGone) {
  const StringTable strings(Language::English);
  Game game(strings);
  game.Players(40).Active = true;
  game.Players(40).MemberIndex = 77;
  Board board([] {});
  ListPastPlayers(
      game, [](std::int32_t) { return std::string(); }, board);
  ASSERT_EQ(board.RowCount(), 1);
  EXPECT_EQ(BoardTexts(game, strings).Cell(board.RowAt(0), BoardColumn::Player), game.DisplayName(40));
}

}  // namespace
