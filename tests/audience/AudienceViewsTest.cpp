#include "audience/AudienceViews.h"

#include <gtest/gtest.h>

#include <QImage>
#include <QPainter>
#include <functional>
#include <vector>

#include "audience/AudienceColours.h"
#include "audience/AudienceText.h"
#include "core/text/StringTable.h"
#include "tests/audience/PaintedLetters.h"

namespace {

struct Hall {
  double Inches;
  double Metres;
};

AudiencePlace PlaceIn(const Hall& hall) {
  constexpr int width = 1920;
  constexpr int height = 1080;
  return {width, height, MillimetresPerPixel(hall.Inches, width, height), hall.Metres};
}

/// Screens that are at least six legible capitals high.
std::vector<Hall> UsableHalls() {
  constexpr double lowest = 6;
  std::vector<Hall> halls;
  for (const double inches : {24.0, 32.0, 43.0, 55.0, 65.0, 75.0, 86.0}) {
    for (const double metres : {2.0, 3.5, 5.0, 7.5, 10.0, 12.0, 15.0}) {
      const AudiencePlace place = PlaceIn({inches, metres});
      if (place.Height * place.MillimetresPerPixel >= lowest * CapitalMillimetres(metres)) {
        halls.push_back({inches, metres});
      }
    }
  }
  return halls;
}

double MinutesOf(const AudiencePlace& place, const std::function<double(QPainter&)>& paint) {
  QImage picture(place.Width, place.Height, QImage::Format_RGB32);
  picture.fill(AudienceColours::Page());
  QPainter painter(&picture);
  const double capital = paint(painter);
  return LegibleMinutes * capital * place.MillimetresPerPixel / CapitalMillimetres(place.Metres);
}

QString Own(Language language, OwnText text) {
  return QString::fromStdString(StringTable(language).Text(text));
}

/// The white square of the code, which reaches over the middle of the picture's height.
QRect CodeOf(const QImage& picture) {
  const int middle = picture.height() / 2;
  int left = 0;
  while (left < picture.width() && picture.pixel(left, middle) != qRgb(255, 255, 255)) {
    ++left;
  }
  int top = middle;
  while (top > 0 && picture.pixel(left, top - 1) == qRgb(255, 255, 255)) {
    --top;
  }
  int bottom = middle;
  while (bottom + 1 < picture.height() && picture.pixel(left, bottom + 1) == qRgb(255, 255, 255)) {
    ++bottom;
  }
  return {left, top, bottom - top + 1, bottom - top + 1};
}

class ViewInEachHall : public testing::TestWithParam<Language> {};

TEST_P(ViewInEachHall, HasALegibleAddressBesideTheCode) {
  for (const Hall& hall : UsableHalls()) {
    const AudiencePlace place = PlaceIn(hall);
    const double minutes = MinutesOf(place, [&](QPainter& painter) {
      return AudienceViews::PaintCode(painter, place, Own(GetParam(), OwnText::AudiencePhone),
                                      QStringLiteral("http://192.168.178.120:8080"));
    });
    EXPECT_GE(minutes, LegibleMinutes) << hall.Inches << " inches, " << hall.Metres << " m";
  }
}

TEST_P(ViewInEachHall, TellsLegiblyThatScoresComeIn) {
  for (const Hall& hall : UsableHalls()) {
    const AudiencePlace place = PlaceIn(hall);
    const double minutes = MinutesOf(place, [&](QPainter& painter) {
      return AudienceViews::PaintMessage(painter, place, Own(GetParam(), OwnText::AudienceIncoming),
                                         QStringLiteral("12 / 40"));
    });
    EXPECT_GE(minutes, LegibleMinutes) << hall.Inches << " inches, " << hall.Metres << " m";
  }
}

TEST_P(ViewInEachHall, NamesTheVenueLegiblyWithAndWithoutAPicture) {
  QImage photograph(64, 48, QImage::Format_RGB32);
  photograph.fill(Qt::red);
  for (const Hall& hall : UsableHalls()) {
    const AudiencePlace place = PlaceIn(hall);
    for (const QImage& picture : {QImage(), photograph}) {
      const double minutes = MinutesOf(place, [&](QPainter& painter) {
        return AudienceViews::PaintVenue(painter, place, QStringLiteral("Laser Arena North"), picture);
      });
      EXPECT_GE(minutes, LegibleMinutes) << hall.Inches << " inches, " << hall.Metres << " m";
    }
  }
}

TEST_P(ViewInEachHall, IsPaintedInLettersThatStandOut) {
  const AudiencePlace place = PlaceIn({55, 10});
  const std::vector<std::function<void(QPainter&)>> views = {
      [&](QPainter& painter) {
        AudienceViews::PaintMessage(painter, place, Own(GetParam(), OwnText::AudienceIncoming),
                                    QStringLiteral("12 / 40"));
      },
      [&](QPainter& painter) {
        AudienceViews::PaintVenue(painter, place, QStringLiteral("Laser Arena North"), {});
      }};
  for (const auto& paint : views) {
    QImage picture(place.Width, place.Height, QImage::Format_RGB32);
    picture.fill(AudienceColours::Page());
    QPainter painter(&picture);
    paint(painter);
    painter.end();
    const PaintedLetters letters = LettersIn(picture, picture.rect());
    EXPECT_EQ(QColor(letters.Ground), AudienceColours::Page());
    EXPECT_GT(letters.Pixels, 5000);
    EXPECT_GT(letters.Legible, letters.Pixels * 3 / 4);
  }
}

TEST_P(ViewInEachHall, KeepsTheTextsOffTheCode) {
  for (const Hall& hall : UsableHalls()) {
    const AudiencePlace place = PlaceIn(hall);
    QImage picture(place.Width, place.Height, QImage::Format_RGB32);
    picture.fill(AudienceColours::Page());
    QPainter painter(&picture);
    AudienceViews::PaintCode(painter, place, Own(GetParam(), OwnText::AudiencePhone),
                             QStringLiteral("http://192.168.178.120:8080"));
    painter.end();
    const QRect code = CodeOf(picture);
    ASSERT_GT(code.width(), place.Height / 3);
    // Right of the code there is a strip in which nothing stands.
    const QRect strip(code.right() + 1, code.top(), place.Width / 100, code.height());
    EXPECT_EQ(LettersIn(picture, strip).Pixels, 0) << hall.Inches << " inches, " << hall.Metres << " m";
  }
}

INSTANTIATE_TEST_SUITE_P(Languages, ViewInEachHall,
                         testing::Values(Language::English, Language::SimplifiedChinese));

TEST(AudienceViews, NameALongVenueInSeveralLines) {
  const AudiencePlace place = PlaceIn({55, 10});
  const double minutes = MinutesOf(place, [&](QPainter& painter) {
    return AudienceViews::PaintVenue(
        painter, place, QStringLiteral("The Old Harbour Laser Tag and Adventure Centre of Northshore"), {});
  });
  EXPECT_GE(minutes, LegibleMinutes);
}

TEST(AudienceText, BreaksBetweenWordsIntoEvenLines) {
  EXPECT_EQ(BrokenInto(QStringLiteral("Your score on your phone"), 1, true),
            QStringList{QStringLiteral("Your score on your phone")});
  EXPECT_EQ(BrokenInto(QStringLiteral("Your score on your phone"), 2, true),
            (QStringList{QStringLiteral("Your score on"), QStringLiteral("your phone")}));
  EXPECT_EQ(BrokenInto(QStringLiteral("http://192.168.1.20:8080"), 3, true).join(QString()),
            QStringLiteral("http://192.168.1.20:8080"));
  EXPECT_EQ(BrokenInto(QStringLiteral("http://192.168.1.20:8080"), 2, true).size(), 2);
  EXPECT_EQ(BrokenInto(QStringLiteral("Arena"), 4, true), QStringList{QStringLiteral("Arena")});
}

}  // namespace
