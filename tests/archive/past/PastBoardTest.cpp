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
      "(8, 'Cy', 'Fox', 'Owl')");
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

  PastGame past(venue.Strings);
  ASSERT_TRUE(ReadGameFile(WriteGameFile(session.Game(), "None"), past.Game, [](const std::string&) {}));
  Board board([] {});
  ListPastPlayers(
      past, [&session](std::int32_t contactId) { return session.Members().NickNameOf(contactId); }, board);
  const Board& before = session.List(BoardList::Players);
  const BoardTexts texts(past.Game, venue.Strings);
  ASSERT_EQ(board.RowCount(), 60);
  for (int place = 0; place < board.RowCount(); ++place) {
    for (int column = 0; column < BoardColumnCount; ++column) {
      const auto which = static_cast<BoardColumn>(column);
      EXPECT_EQ(texts.Cell(board.RowAt(place), which), venue.Texts.Cell(before.RowAt(place), which))
          << place << ", " << column;
    }
  }
}

/// A player's cell of a past game in which Blue 7 is member 77.
std::string CellOf(const std::string& nickName, const GuestList::Names& guests) {
  const StringTable strings(Language::English);
  PastGame past(strings);
  past.Game.Players(40).Active = true;
  past.Game.Players(40).MemberIndex = 77;
  past.Guests = guests;
  Board board([] {});
  ListPastPlayers(
      past, [&nickName](std::int32_t) { return nickName; }, board);
  return BoardTexts(past.Game, strings).Cell(board.RowAt(0), BoardColumn::Player);
}

TEST(PastBoards, NameAPlayerByNicknameElseByGuestNameElseByTheGun) {
  EXPECT_EQ(CellOf("Mole", {{40, "Ann"}}), "Blue  7: Mole");
  EXPECT_EQ(CellOf("", {{40, "Ann"}, {1, "Ben"}}), "Blue  7: Ann");
  EXPECT_EQ(CellOf("", {}), "Blue  7");
}

TEST(PastBoards, ShowNamesClean) {
  EXPECT_EQ(CellOf(" Mo\tle\xE2\x80\xAE ", {}), "Blue  7: Mole");
  EXPECT_EQ(CellOf("\xE2\x80\xAE", {{40, "A\nnn"}}), "Blue  7: Ann");
}

}  // namespace
