#include <gtest/gtest.h>

#include <QHeaderView>
#include <QScrollBar>
#include <algorithm>
#include <memory>

#include "board/BoardLetters.h"
#include "board/ScoreListView.h"
#include "tests/support/OnScreen.h"
#include "tests/support/Venue.h"

// The board in the main window, measured on a picture.

namespace {

/// Of a screen of 1920 x 1080 pixels, less a window's frame.
constexpr QSize FullScreen(1920, 1050);

/// Guns of the Blue team, from Blue 0 on; the second one is the member HEIKE's.
std::string GameOf(int guns) {
  std::string players;
  for (int gun = 0; gun < guns; ++gun) {
    players += PlayerOf(33 + gun, "<BonusPoints>" + std::to_string(900 - gun) +
                                      "</BonusPoints><ShotCount>250</ShotCount><PrimaryDamage>10"
                                      "</PrimaryDamage><DeathCount>12</DeathCount>" +
                                      (gun == 1 ? "<MemberIndex>4</MemberIndex>" : ""));
  }
  return GameFile(players);
}

class BoardPicture : public testing::Test {
 protected:
  BoardPicture() { UseLanguage(Language::English); }

  void UseLanguage(Language language) {
    venue = std::make_unique<Venue>(language);
    venue->PutDefaultFiles();
    venue->ChangeDatabase("members.mdb",
                          "INSERT INTO Members (ContactID, FirstName, LastName, NickName) VALUES (4, 'A', "
                          "'B', 'HEIKE')");
  }

  ScoreListView& ShowBoard(int guns, const QSize& size) {
    venue->MakeWindow().FormLoad();
    venue->Window->setWindowState(Qt::WindowNoState);
    Show(*venue->Window);
    venue->Window->resize(size);  // larger than the screen of the tests
    if (guns > 0) {
      venue->LoadGame(GameOf(guns));
    }
    QCoreApplication::processEvents();
    return Board();
  }

  /// How many texts without a common line stand one above the other in a player's cell.
  int TextsInCell(int row) {
    const QRect cell = Board().visualRect(Board().model()->index(row, 1));
    const QImage picture = Board().viewport()->grab(cell).toImage();
    int texts = 0;
    bool wasInk = false;
    for (int y = 0; y < picture.height(); ++y) {
      bool ink = false;
      for (int x = 0; x < picture.width(); ++x) {
        ink |= IsInk(picture, x, y);
      }
      texts += ink && !wasInk ? 1 : 0;
      wasInk = ink;
    }
    return texts;
  }

  ScoreListView& Board() { return venue->Find<ScoreListView>("ScoreDisplay"); }

  /// Height in pixels of the first letter of a player's name as it is painted.
  int HeightOfFirstLetter(int row) {
    const QRect cell = Board().visualRect(Board().model()->index(row, 1));
    const QImage picture = Board().viewport()->grab(cell).toImage();
    const auto inkInColumn = [&](int x) {
      int count = 0;
      for (int y = 0; y < picture.height(); ++y) {
        count += IsInk(picture, x, y) ? 1 : 0;
      }
      return count;
    };
    int x = 0;  // of the upright stroke at its left
    while (x < picture.width() && inkInColumn(x) < picture.height() / 4) {
      ++x;
    }
    int highest = 0;  // of what is without a gap: the gun of a member stands above
    int height = 0;
    for (int y = 0; y < picture.height(); ++y) {
      height = IsInk(picture, x + 1, y) ? height + 1 : 0;
      highest = std::max(highest, height);
    }
    return highest;
  }

  std::unique_ptr<Venue> venue;

 private:
  /// Of a letter: the badge is coloured.
  static bool IsInk(const QImage& picture, int x, int y) {
    constexpr int half = 115;  // between the text and the row's colour
    constexpr int coloured = 50;
    const QColor colour = picture.pixelColor(x, y);
    const auto [least, most] = std::minmax({colour.red(), colour.green(), colour.blue()});
    return colour.lightness() < half && most - least < coloured;
  }
};

TEST_F(BoardPicture, HasCapitalsThatCanBeReadFromTwoMetresInTwelveRows) {
  for (const Language language : {Language::English, Language::SimplifiedChinese}) {
    UseLanguage(language);
    for (const int points : {9, 11, 14}) {
      const FontOfSize font(points);
      const ScoreListView& board = ShowBoard(12, FullScreen);
      if (language == Language::English) {  // no capitals in the other's names of teams
        EXPECT_GE(HeightOfFirstLetter(0), ReadableCapitals) << "a gun, " << points;
      }
      EXPECT_GE(HeightOfFirstLetter(1), ReadableCapitals) << "a member, " << points;
      EXPECT_EQ(TextsInCell(1), 2) << points;
      EXPECT_FALSE(board.verticalScrollBar()->isVisible()) << points;
      EXPECT_FALSE(board.horizontalScrollBar()->isVisible()) << points;
      venue->Window.reset();
    }
  }
}

TEST_F(BoardPicture, HasGunAndMemberApartInEachLanguage) {
  for (const Language language : {Language::English, Language::SimplifiedChinese}) {
    for (const int points : {9, 11}) {
      for (const int guns : {12, 60}) {
        const FontOfSize font(points);
        UseLanguage(language);
        ShowBoard(guns, FullScreen);
        EXPECT_EQ(TextsInCell(0), 1);
        EXPECT_EQ(TextsInCell(1), 2) << guns << " guns, " << points << " points";
        venue->Window.reset();
      }
    }
  }
}

TEST_F(BoardPicture, NeedsNoScrollBarsForTwelveGuns) {
  for (const QSize& size : {QSize(1366, 768), QSize(1600, 900), FullScreen, QSize(2560, 1560)}) {
    for (const int points : {9, 11, 14}) {
      const FontOfSize font(points);
      ShowBoard(12, size);
      for (const char* name : {"ScoreDisplay", "TeamScores"}) {
        const auto& list = venue->Find<ScoreListView>(name);
        EXPECT_FALSE(list.horizontalScrollBar()->isVisible())
            << name << " at " << size.width() << " with " << points << " points";
      }
      venue->Window.reset();
    }
  }
}

TEST_F(BoardPicture, HasNeverSmallerLettersThanTheLeast) {
  const ScoreListView& board = ShowBoard(60, FullScreen);
  EXPECT_TRUE(board.verticalScrollBar()->isVisible());
  EXPECT_GE(HeightOfFirstLetter(0), static_cast<int>(board.LeastCapitals()));
}

TEST_F(BoardPicture, HasColumnsOfTheToldSharesAsLongAsNothingNeedsMore) {
  for (const int guns : {0, 60}) {
    for (const QSize& size : {FullScreen, QSize(1280, 950)}) {
      const ScoreListView& board = ShowBoard(guns, size);
      const double width = board.viewport()->width();
      for (int column = 0; column < BoardColumnCount; ++column) {
        const double share = 1.0 / 9 + (column == 0 ? -0.027 : column == 1 ? 0.027 : 0);
        EXPECT_NEAR(board.columnWidth(column), width * share, BoardColumnCount)
            << guns << " guns, " << size.width() << ", column " << column;
      }
      venue->Window.reset();
    }
  }
}

}  // namespace
