#include "audience/AudienceViews.h"

#include <gtest/gtest.h>

#include <QImage>
#include <QPainter>
#include <functional>
#include <vector>

#include "audience/AudienceColours.h"
#include "audience/AudienceText.h"
#include "core/text/StringTable.h"

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
