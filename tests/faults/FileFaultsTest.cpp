#include <gtest/gtest.h>

#include <cstdlib>
#include <filesystem>
#include <memory>
#include <set>
#include <string>

#include "core/data/FirstRun.h"
#include "core/data/IniReader.h"
#include "core/data/UserDatabase.h"
#include "core/game/Session.h"
#include "core/gamefile/CurrentGameFile.h"
#include "core/gamefile/GameFile.h"
#include "platform/linux/LinuxFiles.h"
#include "sheets/ScoreSheets.h"
#include "tests/fakes/FakeClock.h"
#include "tests/fakes/FakeEventPump.h"
#include "tests/fakes/FakeFileDialog.h"
#include "tests/fakes/FakeFolders.h"
#include "tests/fakes/FakeMessageBoxes.h"
#include "tests/fakes/FakeOldDatabases.h"
#include "tests/fakes/FakeSheetProgress.h"
#include "tests/fakes/FakeWordProcessor.h"
#include "tests/faults/FaultLoop.h"
#include "tests/support/DatabaseContents.h"
#include "tests/support/MadeDatabase.h"
#include "tests/support/ScoredGame.h"

namespace {

/// The number and text of the file layer for a fault on one of the files in `folder`.
bool FileFaultFits(const FileFault& fault, const Thrown& told, const std::string& folder) {
  const auto is = [&](int number, const std::string& start) {
    return told.Number == number && told.Text.starts_with(start + ": " + folder);
  };
  switch (fault.Error) {
    case ENOSPC:
    case EDQUOT:
      return is(Fault::DiskFull, "Disk full") || is(Fault::PathAccess, "Path/File access error");
    case EACCES:
      return is(Fault::PermissionDenied, "Permission denied") ||
             is(Fault::PathAccess, "Path/File access error");
    case EIO:
      return is(Fault::PathAccess, "Path/File access error");
    default:
      return false;
  }
}

/// Names and bytes of all files in a folder, except those begun but not finished: with the disk out of order
/// they cannot always be deleted, and nothing ever reads them.
std::string FilesIn(const std::string& folder) {
  std::set<std::string> files;
  for (const auto& entry : std::filesystem::recursive_directory_iterator(folder)) {
    const std::string name = entry.path().filename();
    if (entry.is_regular_file() && !name.starts_with(".new-")) {
      files.insert(entry.path().string().substr(folder.size()) + ": " + ReadFile(entry.path()) + "\n");
    }
  }
  std::string all;
  for (const std::string& file : files) {
    all += file;
  }
  return all;
}

class OnFiles : public FaultyOperation {
 public:
  std::string State() const override { return FilesIn(Folder()); }
  bool Fits(const FileFault& fault, const std::string& /*call*/, const Thrown& told) const override {
    return FileFaultFits(fault, told, Folder());
  }
  bool CanFailWhenDone() const override { return true; }

  LinuxFiles Disk;
  FakeMessageBoxes Boxes;
  StringTable Strings{Language::English};
};

struct GameSaved : OnFiles {
  GameSaved() { WriteFile(*this / "game.xml", Old()); }

  static std::string Old() { return std::string(70'000, 'o'); }

  void Act() override {
    Dialog.Answers = {*this / "game.xml"};
    File.SaveGame(Played, "None");
  }

  /// The text never denies a file that is there.
  bool Fits(const FileFault& fault, const std::string& call, const Thrown& told) const override {
    const bool isNew = ReadFile(*this / "game.xml") != Old();
    return OnFiles::Fits(fault, call, told) &&
           told.Text.ends_with(" (done, but a power failure may undo it)") == isNew;
  }

  FakeFileDialog Dialog;
  Game Played{Strings};
  CurrentGameFile File{Dialog, Disk, Boxes};
};

struct SettingSaved : OnFiles {
  SettingSaved() {
    WriteFile(*this / "tessarine.ini",
              "; mine\r\n[communications]\r\ncommport=1\r\n\r\n[other]\r\nkey=5\r\n");
  }

  void Act() override { IniReader(Disk, *this / "tessarine.ini").WriteIni("other", "key", "7"); }
  bool IsSilent() const override { return true; }
};

/// The program's files and the user's data folder, under one roof.
class OnDataFolder : public OnFiles {
 public:
  OnDataFolder() {
    std::filesystem::create_directories(*this / "program");
    std::filesystem::create_directories(*this / "data");
    for (const std::string name : {"scenarios", "members"}) {
      WriteFile(*this / "program/" + name + "_default.mdb", MadeDatabase(name));
    }
    WriteFile(*this / "program/score_card_default.doc", "card");
    WriteFile(*this / "program/tessarine.ini", "[communications]\n");
    Places.LocalAppDataPath = *this / "data";
    Places.ProgramPath = *this / "program";
  }

  FakeFolders Places;
  FakeOldDatabases Old;
  FakeClock Time;
  SqliteEngine Databases{std::chrono::milliseconds(0)};
};

/// A start of the program up to the main window.
class Started : public OnDataFolder {
 public:
  void Act() override {
    const std::string folder = PrepareUserDataFolder(Places, Disk, Boxes);
    Session session(Strings, Time, Boxes);
    if (!session.Open({Databases, Old, Disk, folder, Places.Program()})) {
      throw RuntimeError(Fault::InternalError, "the program was ended");
    }
    EXPECT_EQ(session.RsScenarios().RecordCount() + 2, static_cast<int>(session.Missions().Items().size()));
    EXPECT_NO_THROW(IniReader(Disk, folder + "/tessarine.ini").ReadIni("communications", "commport", "1"));
  }

  bool Fits(const FileFault& fault, const std::string& call, const Thrown& told) const override {
    const std::string folder = *this / "data/Orvalin/Tessarine";
    return FileFaultFits(fault, told, Folder()) ||
           DatabaseFaultFits(fault, call, told, folder + "/scenarios.mdb") ||
           DatabaseFaultFits(fault, call, told, folder + "/members.mdb");
  }
};

/// In an empty data folder. It is complete or will be at the next start: no file is half there.
struct FirstStart : Started {
  std::string State() const override {
    const std::string folder = *this / "data/Orvalin/Tessarine";
    for (const auto& [name, source] : {std::pair{"scenarios.mdb", "scenarios_default.mdb"},
                                       {"members.mdb", "members_default.mdb"},
                                       {"score_card.doc", "score_card_default.doc"},
                                       {"tessarine.ini", "tessarine.ini"}}) {
      const std::string path = folder + "/" + name;
      if (!std::filesystem::exists(path)) {
        return "not complete";
      }
      EXPECT_EQ(ReadFile(path), ReadFile(*this / "program/" + source)) << name;
    }
    return "complete";
  }
};

/// With the operator's own data in the folder. Nothing there changes, whatever fails.
struct LaterStart : Started {
  LaterStart() {
    const std::string folder = *this / "data/Orvalin/Tessarine";
    std::filesystem::create_directories(folder);
    WriteFile(folder + "/scenarios.mdb", MadeDatabase("scenarios"));
    WriteFile(folder + "/members.mdb",
              MadeDatabase("members", "INSERT INTO Members (FirstName) VALUES ('Mine')"));
    WriteFile(folder + "/score_card.doc", "my card");
    WriteFile(folder + "/tessarine.ini", "mine=1\n");
  }

  void Check() const override { EXPECT_TRUE(Boxes.Boxes.empty()) << Boxes.Boxes.back(); }
};

/// The operator goes on with a fresh copy beside a damaged file.
struct FreshCopyMade : OnDataFolder {
  FreshCopyMade() { WriteFile(*this / "data/members.mdb", std::string(9000, 'd')); }

  void Act() override {
    const std::unique_ptr<Database> database = OpenUserDatabase(
        {*this / "data/members.mdb", "Members", *this / "program/members_default.mdb"}, {.Engine = Databases,
                                                                                         .Old = Old,
                                                                                         .Disk = Disk,
                                                                                         .Boxes = Boxes,
                                                                                         .Copies = Copies,
                                                                                         .Strings = Strings});
    EXPECT_NE(database, nullptr);
  }

  bool Fits(const FileFault& fault, const std::string& call, const Thrown& told) const override {
    return FileFaultFits(fault, told, Folder()) ||
           DatabaseFaultFits(fault, call, told, *this / "data/members.mdb") ||
           DatabaseFaultFits(fault, call, told, *this / "data/members-new.mdb");
  }

  Backups Copies{*this / "backups", Disk, Time, Strings};
};

/// A run of sheets for one member with a photo, with a word processor that only remembers.
class SheetsMade : public OnFiles {
 public:
  SheetsMade() {
    std::filesystem::create_directories(*this / "tmp");
    setenv("TMPDIR", (*this / "tmp").c_str(), 1);
    WriteFile(
        venue_.MembersFile(),
        MadeDatabase("members",
                     "INSERT INTO Members (ContactID, FirstName, LastName, PhotographLength, Photograph) "
                     "VALUES (3, 'Ann', 'Lee', 4, x'01020304')"));
    venue_.Open();
    venue_.Activate(1).MemberIndex = 3;
    choice_.SheetSelection = SheetSelection::Active;
    choice_.OutputTarget = OutputTarget::Files;
  }
  ~SheetsMade() override { unsetenv("TMPDIR"); }

  /// What the operator is told of a failure has a text and no number.
  void Act() override {
    word_.OnOperation = [](const std::string& operation) {
      if (operation.starts_with("SaveAs ")) {
        WriteFile(operation.substr(7), "sheet");  // as the word processor does, by itself
      }
    };
    venue_.Boxes.Boxes.clear();
    ScoreSheets({.Game = venue_.game,
                 .RsMembers = *venue_.RsMembers,
                 .Members = *venue_.Members,
                 .Strings = Strings,
                 .Time = clock_,
                 .Events = events_,
                 .Disk = Disk,
                 .Boxes = venue_.Boxes,
                 .WordApp = word_,
                 .UprightPicture = [](const std::string& photo) { return photo + "turned"; },
                 .Progress = progress_,
                 .UserDataFolder = Folder(),
                 .MissionName = "None"},
                choice_)
        .GenerateScoreSheets();
    ASSERT_EQ(venue_.Boxes.Boxes.size(), 1U);
    if (venue_.Boxes.Boxes.back().Icon != BoxIcon::Information) {
      throw RuntimeError(Fault::InternalError, venue_.Boxes.Boxes.back().Text);
    }
  }

  /// Whether the sheet was made. Every further run makes one more.
  std::string State() const override {
    return Disk.FileNames(*this / "scores").empty() ? "no sheet" : "a sheet";
  }

  bool Fits(const FileFault& /*fault*/, const std::string& /*call*/, const Thrown& told) const override {
    return told.Text == "Failed to create sub folder for score saving." ||
           told.Text == "Error occured getting Memmber photo." ||
           told.Text == "Error occured during file saving." ||
           told.Text.starts_with("Path/File access error: " + *this / "tmp") ||
           told.Text.starts_with("Permission denied: " + *this / "tmp");
  }

 private:
  ScoredGame venue_;
  FakeClock clock_;
  FakeEventPump events_;
  FakeWordProcessor word_;
  FakeSheetProgress progress_;
  PrintChoice choice_;
};

template <typename Operation>
class FilesUnderFaults : public testing::Test {};

using FileOperations =
    testing::Types<GameSaved, SettingSaved, FirstStart, LaterStart, FreshCopyMade, SheetsMade>;
TYPED_TEST_SUITE(FilesUnderFaults, FileOperations);

TYPED_TEST(FilesUnderFaults, AreOldOrNewAndTheNextTryWorks) {
  const FaultRun run = FailAtEveryCall<TypeParam>();
  EXPECT_EQ(run.Before == run.After, (std::is_same_v<TypeParam, LaterStart>));
  EXPECT_GT(run.Failures, 20);
}

}  // namespace
