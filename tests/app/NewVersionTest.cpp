#include <gmock/gmock.h>

#include <QListWidget>
#include <QToolButton>

#include "tests/support/Venue.h"

namespace {

using testing::IsEmpty;

class NewVersion : public testing::Test {
 protected:
  /// What the status line says at a start of this version.
  std::string ToldBy(const std::string& release) {
    venue.Window.reset();
    venue.Release = release;
    venue.Start();
    const auto* entry = venue.Window->findChild<QWidget*>(QStringLiteral("NewVersion"));
    return entry != nullptr && entry->isVisible() ? entry->property("text").toString().toStdString()
                                                  : std::string();
  }

  Venue venue;
};

TEST_F(NewVersion, IsToldOnceWithoutABox) {
  EXPECT_EQ(ToldBy("3.54 (1)"), "") << "the first start of all";
  EXPECT_EQ(ToldBy("3.54 (1)"), "");
  EXPECT_EQ(ToldBy("3.54 (2)"), "This is a new version: 3.54 (2)");
  EXPECT_EQ(ToldBy("3.54 (2)"), "");
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
}

TEST_F(NewVersion, IsToldAfterAVersionThatDidNotRememberItself) {
  venue.PutDefaultFiles();
  WriteFile(venue.DataFile("state.ini"), "[games]\nsave_folder=/home/anna\n");
  EXPECT_EQ(ToldBy("3.54 (2)"), "This is a new version: 3.54 (2)");
}

TEST_F(NewVersion, LeadsToWhatIsNew) {
  ToldBy("3.54 (1)");
  ToldBy("3.54 (2)");
  venue.Find<QToolButton>("WhatIsNewLink").click();
  const auto open = QApplication::topLevelWidgets();
  const auto manual = std::find_if(open.begin(), open.end(), [](const QWidget* window) {
    return window->objectName() == QStringLiteral("ManualWindow") && window->isVisible();
  });
  ASSERT_NE(manual, open.end());
  EXPECT_EQ((*manual)->findChild<QListWidget*>(QStringLiteral("Pages"))->currentItem()->text(),
            QStringLiteral("What is new"));
}

TEST_F(NewVersion, DoesNotStopAProgramThatCannotRememberIt) {
  venue.PutDefaultFiles();
  std::filesystem::create_directory(venue.DataFile("state.ini"));
  EXPECT_EQ(ToldBy("3.54 (1)"), "");
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
}

}  // namespace
