#include "ui/WindowPlaces.h"

#include <gmock/gmock.h>

#include <QDialog>
#include <QFileDialog>
#include <QMessageBox>

#include "tests/fakes/FakeFiles.h"
#include "tests/support/CaredFor.h"
#include "tests/support/Controls.h"

namespace {

using testing::IsEmpty;

constexpr const char* Path = "/data/state.ini";
const QRect Left(0, 0, 1280, 1024);
const QRect Right(1280, 100, 1024, 768);

TEST(WindowPlace, ComesBackFromItsText) {
  for (const bool maximised : {false, true}) {
    const WindowPlace place{QRect(-20, 30, 900, 640), maximised};
    EXPECT_EQ(PlaceOf(TextOf(place)), place);
  }
  EXPECT_EQ(TextOf({QRect(120, 80, 900, 640), true}), "120,80,900,640,maximised");
}

TEST(WindowPlace, IsNoneWhereTheTextIsNonsense) {
  for (const char* text : {"", "1,2,3", "a,2,300,400", "1,2,0,400", "1,2,300,-1", "1,2,300,400,large",
                           "1,2,300,400,,", "1,2,99999999999,5", "1,2,300000,5"}) {
    EXPECT_EQ(PlaceOf(text), std::nullopt) << text;
  }
}

TEST(PlaceWithin, IsThePlaceItselfWhereItIsOnAScreen) {
  EXPECT_EQ(PlaceWithin(QRect(100, 90, 500, 400), {Left, Right}), QRect(100, 90, 500, 400));
  EXPECT_EQ(PlaceWithin(QRect(1400, 190, 500, 400), {Left, Right}), QRect(1400, 190, 500, 400));
}

TEST(PlaceWithin, IsMovedToTheScreenThatShowsMostOfIt) {
  EXPECT_EQ(PlaceWithin(QRect(-100, -90, 500, 400), {Left, Right}).topLeft(), Left.topLeft());
  EXPECT_EQ(PlaceWithin(QRect(1200, 0, 500, 400), {Left, Right}).topLeft(), Right.topLeft());
}

TEST(PlaceWithin, IsOnTheFirstScreenIfItsOwnIsGone) {
  const QRect place = PlaceWithin(QRect(1400, 190, 500, 400), {Left});
  EXPECT_TRUE(Left.contains(place));
  EXPECT_EQ(place.size(), QSize(500, 400));
  EXPECT_TRUE(Left.contains(PlaceWithin(QRect(-9000, 9000, 500, 400), {Left, Right})));
}

TEST(PlaceWithin, IsMadeSmallerForASmallerScreen) {
  const QRect place = PlaceWithin(QRect(0, 0, 3000, 2000), {Right});
  EXPECT_TRUE(Right.contains(place));
  EXPECT_GT(place.width(), 1000);
}

/// A dialog that is opened and closed several times.
class Places : public testing::Test {
 protected:
  Places() { files.AddFolder("/data"); }

  /// Opens a dialog, calls `act` and closes it; the geometry that it had in the beginning.
  QRect Open(const std::function<void(QDialog&)>& act, const char* name = "Members") {
    QDialog dialog;
    dialog.setObjectName(QString::fromLatin1(name));
    dialog.resize(300, 200);
    Show(dialog);
    const QRect first = dialog.geometry();
    act(dialog);
    dialog.close();
    return first;
  }

  FakeFiles files;
  IniReader ini{files, Path};
  WindowPlaces places{ini};
};

TEST_F(Places, AreRememberedForEachWindow) {
  Open([](QDialog& dialog) { dialog.setGeometry(200, 150, 640, 480); });
  Open([](QDialog& dialog) { dialog.setGeometry(20, 15, 320, 240); }, "Settings");
  EXPECT_EQ(Open([](QDialog&) {}), QRect(200, 150, 640, 480));
  EXPECT_EQ(Open([](QDialog&) {}, "Settings"), QRect(20, 15, 320, 240));
}

TEST_F(Places, OfWindowsThatNobodyMovesAreNotWritten) {
  const QRect first = Open([](QDialog&) {});
  EXPECT_EQ(first.size(), QSize(300, 200));
  EXPECT_THAT(files.Replaced, IsEmpty());
}

TEST_F(Places, AreOnTheScreensOfToday) {
  files.Put(Path, "[windows]\nMembers=-5000,-4000,640,480\n");
  Open([](QDialog& dialog) {
    ExpectInWorkArea(dialog);
    EXPECT_EQ(dialog.size(), QSize(640, 480));
  });
}

TEST_F(Places, SayNothingWhereTheyCannotBeWritten) {
  files.FailReplace(Path, RuntimeError(Fault::PathAccess));
  Open([](QDialog& dialog) { dialog.resize(640, 480); });
  EXPECT_EQ(Open([](QDialog&) {}).size(), QSize(300, 200));
}

TEST_F(Places, OfAWindowThatStandsBesideTheOthersAreRememberedToo) {
  for (const bool again : {false, true}) {
    QWidget manual;
    manual.setObjectName(QStringLiteral("ManualWindow"));
    manual.resize(300, 200);
    Show(manual);
    EXPECT_EQ(manual.size(), again ? QSize(500, 400) : QSize(300, 200));
    manual.resize(500, 400);
    manual.close();
  }
}

TEST_F(Places, OfBoxesAreLeftToTheDesktop) {
  QMessageBox box;
  box.setObjectName(QStringLiteral("Members"));
  Show(box);
  box.move(300, 200);
  box.close();
  EXPECT_THAT(files.Replaced, IsEmpty());
}

}  // namespace
