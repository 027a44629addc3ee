#include "audience/AudiencePages.h"

#include <gtest/gtest.h>

#include <QFontMetricsF>
#include <QImage>
#include <QPainter>

#include "audience/AudienceColours.h"
#include "audience/AudienceText.h"
#include "tests/audience/PaintedLetters.h"

namespace {

AudienceResults ResultsOfPlayers(int players) {
  AudienceResults results;
  results.Mission = "Capture the Flag";
  for (int place = 1; place <= players; ++place) {
    results.Players.push_back({.Place = place,
                               .Index = place,
                               .Team = 1 + place % 3,
                               .Number = place % 32,
                               .Soldiering = 5000 - 20 * place,
                               .PublicName = "Player " + std::to_string(place)});
  }
  for (int team = 1; team <= 3; ++team) {
    results.Totals.push_back({team, 9000 - 1000 * team});
  }
  return results;
}

AudiencePlace FullHd(double inches, double metres) {
  return {1920, 1080, MillimetresPerPixel(inches, 1920, 1080), metres};
}

QImage Painted(const AudiencePages& pages, const AudiencePlace& place, int page) {
  QImage picture(place.Width, place.Height, QImage::Format_RGB32);
  picture.fill(AudienceColours::Page());
  QPainter painter(&picture);
  pages.Paint(painter, page);
  painter.end();
  return picture;
}

/// The lowest line of the picture that is no empty page.
int LowestLine(const QImage& picture) {
  for (int y = picture.height() - 1; y >= 0; --y) {
    for (int x = 0; x < picture.width(); ++x) {
      if (picture.pixelColor(x, y) != AudienceColours::Page()) {
        return y;
      }
    }
  }
  return -1;
}

/// The page on a picture that goes on below and to the right of the place.
QImage PaintedWithRoomAround(const AudiencePages& pages, const AudiencePlace& place, int page) {
  QImage picture(place.Width + 200, place.Height + 200, QImage::Format_RGB32);
  picture.fill(AudienceColours::Page());
  QPainter painter(&picture);
  pages.Paint(painter, page);
  painter.end();
  return picture;
}

TEST(AudienceColours, AreLegibleFromAfar) {
  using namespace AudienceColours;
  EXPECT_GE(::Contrast(Letters().rgb(), Page().rgb()), LeastContrastForTheHall);
  EXPECT_GE(::Contrast(QuietLetters().rgb(), Page().rgb()), LeastContrastForTheHall);
  for (int team = 1; team <= 3; ++team) {
    EXPECT_GE(::Contrast(Letters().rgb(), Row(team).rgb()), LeastContrastForTheHall) << team;
    EXPECT_GE(::Contrast(Team(team).rgb(), Row(team).rgb()), LeastContrastForTheHall) << team;
    EXPECT_GE(::Contrast(Team(team).rgb(), Page().rgb()), LeastContrastForTheHall) << team;
    EXPECT_GE(::Contrast(BadgeLetters().rgb(), Team(team).rgb()), LeastContrastForTheHall) << team;
    EXPECT_NE(Team(team), QColor(Qt::white)) << team;
  }
}

/// Letters of this part of a page are painted so that they can be read, and on the ground that is meant.
void ExpectLegible(const QImage& page, const QRectF& part, const QColor& ground) {
  const PaintedLetters letters = LettersIn(page, part.toRect());
  EXPECT_EQ(QColor(letters.Ground), ground);
  EXPECT_GT(letters.Pixels, 500);
  EXPECT_GT(letters.Legible, letters.Pixels / 2);
}

TEST(AudiencePages, ArePaintedInLettersThatCanBeReadFromAfar) {
  const AudienceResults results = ResultsOfPlayers(12);
  for (const Language language : {Language::English, Language::SimplifiedChinese}) {
    const StringTable strings(language);
    for (const AudiencePlace& place : {FullHd(55, 10), FullHd(43, 10)}) {
      const AudiencePages pages(results, strings, place);
      const AudienceLayout& layout = pages.Layout();
      ASSERT_EQ(layout.Columns, 1);
      const QImage page = Painted(pages, place, 0);
      const double width = place.Width - 2 * layout.Margin;
      double top = layout.Margin;
      for (int line = 0; line < 1 + layout.TotalLines; ++line) {
        ExpectLegible(page, {layout.Margin, top, width, layout.Pitch}, AudienceColours::Page());
        top += layout.Pitch;
      }
      for (int row = 0; row < layout.Winners + layout.FirstRows; ++row) {
        const double pitch = layout.Pitch * (row < layout.Winners ? layout.WinnerScale : 1);
        const QRectF line(layout.Margin, top, width, 0.9 * pitch);
        const int team = results.Players[static_cast<std::size_t>(row)].Team;
        ExpectLegible(page, line, AudienceColours::Row(team));
        // The badge stands in the left half, the name of a winner may reach into it in the same colour.
        const QRectF left(layout.Margin, top, layout.Capital * layout.WinnerScale * 4, 0.9 * pitch);
        const QRect badge = AreaOfColour(page, left.toRect(), AudienceColours::Team(team).rgb());
        const PaintedLetters letter = LettersIn(page, badge.adjusted(0, 0, -badge.width() / 3, 0));
        EXPECT_GT(letter.Legible, 50);
        top += pitch;
      }
    }
  }
}

TEST(AudienceText, HasCapitalsOfAtLeastTheHeightAskedFor) {
  for (const double capital : {7.3, 16.0, 36.7, 95.2}) {
    for (const bool bold : {false, true}) {
      const double height = QFontMetricsF(FontWithCapitals(capital, bold)).capHeight();
      EXPECT_GE(height, capital);
      EXPECT_LE(height, capital + 1.5);
    }
  }
}

TEST(AudiencePages, EndWithinTheScreen) {
  const StringTable strings(Language::English);
  for (const int players : {1, 3, 12, 40, 224}) {
    const AudienceResults results = ResultsOfPlayers(players);
    for (const AudiencePlace& place : {FullHd(55, 5), FullHd(24, 15), FullHd(86, 3)}) {
      const AudiencePages pages(results, strings, place);
      const QImage picture = PaintedWithRoomAround(pages, place, 0);
      EXPECT_GT(LowestLine(picture), place.Height / 8) << players;
      EXPECT_LT(LowestLine(picture), place.Height) << players;
      EXPECT_EQ(LowestLine(picture.copy(place.Width, 0, 200, place.Height)), -1) << players;
    }
  }
}

TEST(AudiencePages, DifferFromPageToPage) {
  const StringTable strings(Language::SimplifiedChinese);
  const AudienceResults results = ResultsOfPlayers(224);
  const AudiencePlace place = FullHd(55, 8);
  const AudiencePages pages(results, strings, place);
  ASSERT_GT(pages.Count(), 2);
  for (int page = 1; page < pages.Count(); ++page) {
    EXPECT_NE(Painted(pages, place, page - 1), Painted(pages, place, page)) << page;
  }
}

TEST(AudiencePages, ShowColourAndLetterOfEachTeam) {
  const StringTable strings(Language::English);
  const AudienceResults results = ResultsOfPlayers(12);
  const AudiencePlace place = FullHd(55, 5);
  const QImage picture = Painted(AudiencePages(results, strings, place), place, 0);
  for (int team = 1; team <= 3; ++team) {
    int pixels = 0;
    for (int y = 0; y < picture.height(); ++y) {
      for (int x = 0; x < picture.width(); ++x) {
        pixels += picture.pixelColor(x, y) == AudienceColours::Team(team) ? 1 : 0;
      }
    }
    EXPECT_GT(pixels, 2000) << team;
  }
}

TEST(AudiencePages, DoNotCutTheTailsOfLetters) {
  const StringTable strings(Language::English);
  AudienceResults results = ResultsOfPlayers(9);
  for (Standing& player : results.Players) {
    player.PublicName = player.Place == 1 ? "ggggg" : " ";
  }
  const AudiencePlace place = FullHd(43, 10);
  const AudiencePages pages(results, strings, place);
  const AudienceLayout& layout = pages.Layout();
  ASSERT_LT(layout.Pitch, 1.5 * layout.Capital);  // lines stand close
  const double firstRow = layout.Pitch * (layout.Winners > 0 ? layout.WinnerScale : 1);
  const int below = static_cast<int>(layout.Margin + (1 + layout.TotalLines) * layout.Pitch + firstRow);
  const QImage picture = Painted(pages, place, 0);
  int pixelsOfTails = 0;
  for (int y = below; y < below + static_cast<int>(layout.Capital / 2); ++y) {
    for (int x = place.Width / 5; x < place.Width / 2; ++x) {  // where the second row has no name
      pixelsOfTails += picture.pixelColor(x, y) != AudienceColours::Row(results.Players[1].Team) ? 1 : 0;
    }
  }
  EXPECT_GT(pixelsOfTails, 20);
}

}  // namespace
