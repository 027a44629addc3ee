#include "demo/Portrait.h"

#include <gtest/gtest.h>

#include <cstdlib>
#include <set>

#include "demo/DemoMembers.h"

namespace {

/// Whether two colours are about the same; light falls on a face from one side.
bool AreAlike(const QColor& one, const QColor& other) {
  constexpr int tolerance = 32;
  return std::abs(one.red() - other.red()) < tolerance && std::abs(one.green() - other.green()) < tolerance &&
         std::abs(one.blue() - other.blue()) < tolerance;
}

TEST(Portrait, ShowsAFaceInFrontOfTheBackdrop) {
  constexpr QPoint betweenTheBrows(180, 184);
  constexpr QPoint backdrop(20, 140);
  for (const DemoMember& member : DemoMembers()) {
    const QImage portrait = DrawPortrait(member.Look);
    EXPECT_EQ(portrait.size(), QSize(PortraitWidth, PortraitHeight));
    EXPECT_TRUE(AreAlike(portrait.pixelColor(betweenTheBrows), QColor(member.Look.Skin)))
        << member.FullName();
    EXPECT_TRUE(AreAlike(portrait.pixelColor(backdrop), QColor(member.Look.Backdrop))) << member.FullName();
  }
}

TEST(Portrait, HasTheChosenHairAndGlasses) {
  PortraitLook look = DemoMembers().front().Look;
  std::set<QByteArray> files;
  int looks = 0;
  for (const Hair hair : {Hair::Shaved, Hair::Short, Hair::SideParting, Hair::Spiky, Hair::Curly, Hair::Bob,
                          Hair::Long, Hair::Bun, Hair::Ponytail}) {
    for (const Glasses glasses : {Glasses::None, Glasses::Round, Glasses::Square}) {
      look.Hair = hair;
      look.Glasses = glasses;
      files.insert(PortraitFile(look));
      ++looks;
    }
  }
  EXPECT_EQ(files.size(), looks);
}

TEST(Portrait, IsAPictureFileThatGoesIntoTheDatabaseWithoutAQuestion) {
  constexpr int largePhoto = 100'000;
  std::set<QByteArray> files;
  for (const DemoMember& member : DemoMembers()) {
    const QByteArray file = PortraitFile(member.Look);
    const QImage picture = QImage::fromData(file, "JPG");
    EXPECT_EQ(picture.size(), QSize(PortraitWidth, PortraitHeight)) << member.FullName();
    EXPECT_LT(file.size(), largePhoto) << member.FullName();
    files.insert(file);
  }
  EXPECT_EQ(files.size(), DemoMembers().size());
}

}  // namespace
