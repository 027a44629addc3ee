#include "tests/faults/WindowFaults.h"

#include "settings/Settings.h"
#include "tests/members/MembersWindow.h"
#include "tests/members/Pictures.h"
#include "tests/missions/Editor.h"
#include "tests/support/Venue.h"

namespace {

using Box = FakeMessageBoxes::Box;

bool IsErrorReport(const Box& box) {
  return box.Text.starts_with("Run-time error '") && box.Title == "Tessarine" &&
         box.Icon == BoxIcon::Critical;
}

/// The main window with a game.
class MainWindowUnderFaults : public testing::Test {
 protected:
  MainWindowUnderFaults() {
    venue.Start();
    venue.LoadGame(SmallGame());
  }

  Venue venue;
};

TEST_F(MainWindowUnderFaults, SavesTheGameOrTellsThatItDidNot) {
  const std::string path = venue.Folder / "saved.xml";
  const auto save = [this, &path] {
    venue.Dialog.Answers = {path};
    venue.Trigger("mnuSaveScores");
  };
  save();
  const std::string game = ReadFile(path);
  ASSERT_FALSE(game.empty());
  int tries = 0;
  const int failures = FailAtEveryCallInWindow({.Folder = venue.Folder.Path(),
                                                .Boxes = venue.Boxes,
                                                .Save = save,
                                                .Stored = [&path] { return ReadFile(path); },
                                                .Wanted = [&game] { return game; },
                                                .Tells = IsErrorReport,
                                                .CanFailWhenDone = true},
                                               [&] { WriteFile(path, "game " + std::to_string(++tries)); });
  EXPECT_GT(failures, 15);
  EXPECT_TRUE(venue.Window->isVisible());
  EXPECT_EQ(venue.RowCount("ScoreDisplay"), 2);
}

TEST_F(MainWindowUnderFaults, KeepsOrChangesTheSettingAndOpensTheWindowAgain) {
  int port = 1;
  const auto save = [this, &port] {
    const WhileModal<Settings> open([&port](Settings& window) {
      Find<QLineEdit>(window, "CommPortNumber").setText(QString::number(port));
      Press(window, "SaveExit");
      EXPECT_FALSE(window.isVisible());
    });
    venue.Trigger("mnuCommPort");
    EXPECT_EQ(open.Runs(), 1);
  };
  const IniReader ini(venue.Disk, venue.DataFile("tessarine.ini"));
  const int failures = FailAtEveryCallInWindow({.Folder = venue.Folder.Path(),
                                                .Boxes = venue.Boxes,
                                                .Save = save,
                                                .Stored = [&ini] { return ini.ReadIni(Keys::CommPort); },
                                                .Wanted = [&port] { return std::to_string(port); },
                                                .Tells = [](const Box&) { return true; },
                                                .IsSilent = true},
                                               [&port] { ++port; });
  EXPECT_GT(failures, 15);
}

/// The mission editor, open on mission "Three".
class EditorUnderFaults : public Editor {};

TEST_F(EditorUnderFaults, SavesTheMissionOrTellsThatItDidNot) {
  int tries = 0;
  const auto wanted = [&tries] { return "text " + std::to_string(tries); };
  Open([&] {
    const auto save = [&] {
      List().setCurrentRow(2);
      Press("Edit");
      Describe(wanted());
      Press("Save");
    };
    const int failures = FailAtEveryCallInWindow(
        {.Folder = venue.DataFolder(),
         .Boxes = venue.Boxes,
         .Save = save,
         .Stored = [this] { return Stored("MissionDescription", "Three"); },
         .Wanted = wanted,
         .Tells = [](const Box& box) { return box == SaveError() || IsErrorReport(box); },
         .CanFailWhenDone = true},
        [&tries] { ++tries; });
    EXPECT_GT(failures, 40);
    EXPECT_EQ(venue.Boxes.Boxes.back(), Saved());
    EXPECT_THAT(Entries(), testing::ElementsAre("One", "Two", "Three"));
    EXPECT_TRUE(Locked());
  });
}

/// The members window on Rhys Morgan, who has a photo of some pages.
class MembersUnderFaults : public MembersWindow {
 protected:
  MembersUnderFaults() {
    Sql("UPDATE Members SET PhotographLength = 20000, Photograph = zeroblob(20000) WHERE ContactID = 1");
  }

  /// The window stays open until OK has succeeded.
  void OpenIfClosed() {
    if (opened_ == nullptr || !opened_->isVisible()) {
      opened_ = std::make_unique<Members>(Members::Parts{*database, venue.Boxes, venue.Dialog, venue.Disk,
                                                         venue.Time, venue.Strings, venue.ButtonSwipe},
                                          nullptr);
      window = opened_.get();
      Show(*window);
    }
  }

  /// A member who could not be read has left the window empty.
  void ShowRhys() {
    OpenIfClosed();
    if (!Line("CityEntry").isEnabled()) {
      Press("ClearSearch");
    }
  }

  static bool IsTold(const Box& box) {
    return IsErrorReport(box) || box.Text.starts_with("Path/File access error: ");
  }

 private:
  std::unique_ptr<Members> opened_;
};

TEST_F(MembersUnderFaults, StoresWhatWasEnteredOrTellsThatItDidNot) {
  int tries = 0;
  const auto wanted = [&tries] { return "City " + std::to_string(tries); };
  const auto save = [&] {
    ShowRhys();
    Enter("CityEntry", wanted());
    Press("OK");
  };
  const int failures = FailAtEveryCallInWindow({.Folder = venue.DataFolder(),
                                                .Boxes = venue.Boxes,
                                                .Save = save,
                                                .Stored = [this] { return Stored("City", 1); },
                                                .Wanted = wanted,
                                                .Tells = IsTold,
                                                .CanFailWhenDone = true},
                                               [&] {
                                                 ++tries;
                                                 ShowRhys();
                                               });
  EXPECT_GT(failures, 40);
  EXPECT_FALSE(window->isVisible());
  EXPECT_EQ(Stored("length(Photograph)", 1), "20000");
}

TEST_F(MembersUnderFaults, StoresThePhotoOrTellsThatItDidNot) {
  int tries = 0;
  const auto save = [this] {
    ShowRhys();
    venue.Dialog.Answers = {venue.DataFile("photo")};
    Press("ChangePicture");
  };
  const int failures = FailAtEveryCallInWindow(
      {.Folder = venue.DataFolder(),
       .Boxes = venue.Boxes,
       .Save = save,
       .Stored = [this] { return Stored("PhotographLength", 1); },
       .Wanted = [&tries] { return std::to_string(20000 + tries); },
       .Tells = IsTold,
       .CanFailWhenDone = true},
      [&] {
        ++tries;
        WriteFile(venue.DataFile("photo"), PictureFileOf(static_cast<std::size_t>(20000 + tries), Qt::red));
        ShowRhys();
      });
  EXPECT_GT(failures, 40);
  EXPECT_TRUE(window->isVisible());
  EXPECT_EQ(Photo().Picture().pixelColor(5, 5), QColor(Qt::red));
}

}  // namespace
