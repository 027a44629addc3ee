#pragma once

#include <chrono>
#include <filesystem>
#include <memory>
#include <set>
#include <string>
#include <vector>

#include "archive/copies/CopyWork.h"
#include "platform/jet/JetConverter.h"
#include "platform/linux/LinuxFiles.h"
#include "platform/sqlite/SqliteDatabase.h"
#include "takeover/TakeOverMark.h"
#include "takeover/TakeOverWork.h"
#include "tests/fakes/FakeClock.h"
#include "tests/support/MadeDatabase.h"

/// A data folder in use, and folders of old installations beside it. All files of one carry its label.
class TakeOverSite {
 public:
  TakeOverSite() : TakeOverSite(std::make_unique<TemporaryFolder>()) {}

  /// In a folder of somebody else.
  explicit TakeOverSite(const std::string& folder) : Folder{folder} {
    std::filesystem::create_directories(Folder / "program");
    for (const char* name : {"members", "scenarios"}) {
      WriteFile(Folder / "program/" + name + "_default.mdb", MadeDatabase(name));
    }
    PutInstallation("data", "Now");
    std::filesystem::create_directories(Data() + "/backups");
    Open();
  }

  std::string Data() const { return Folder / "data"; }

  /// The first bytes of a document, and something behind them.
  static std::string Document(const std::string& label) { return "\xD0\xCF\x11\xE0\xA1\xB1\x1A\xE1" + label; }

  static std::string MembersOf(const std::string& label) {
    return MadeDatabase("members", "INSERT INTO Members (FirstName) VALUES ('" + label + "'), ('Bob')");
  }

  /// Writes all files of an installation.
  void PutInstallation(const std::string& name, const std::string& label) const {
    const std::string folder = Folder / name;
    std::filesystem::create_directories(folder);
    WriteFile(folder + "/members.mdb", MembersOf(label));
    WriteFile(folder + "/scenarios.mdb",
              MadeDatabase("scenarios",
                           "DELETE FROM Table1; INSERT INTO Table1 (MissionName) VALUES ('" + label + "')"));
    WriteFile(folder + "/score_card.doc", Document(label));
    WriteFile(folder + "/tessarine.ini", "; " + label + "\n[comm]\ncommport=3\n[soldiering_calc]\nheals=" +
                                             std::to_string(label.size()) + "\n[ports]\ncom3=/dev/" + label +
                                             "\n");
  }

  void Open() {
    Members = Databases.OpenDatabase(Data() + "/members.mdb");
    Missions = Databases.OpenDatabase(Data() + "/scenarios.mdb");
  }

  TakeOverWork::Parts Parts() {
    return {.Engine = Databases,
            .Old = Old,
            .Disk = Disk,
            .Time = Time,
            .Strings = Strings,
            .DataFolder = Data(),
            .Databases = {Taken(OldItem::Members, "members", "Members", Members),
                          Taken(OldItem::Missions, "scenarios", "Table1", Missions)},
            .Ask =
                [this](const std::string& question) {
                  Questions.push_back(question);
                  return Answer;
                },
            .HasPort = [](std::int16_t number) { return number == 3; }};
  }

  /// Looks at the installation in a folder of the site.
  std::vector<FoundItem> Look(TakeOverWork& work, const std::string& name) const {
    return work.Look(FindOldInstallation(Disk, Folder / name).value(), [](OldItem) { return true; });
  }

  static TakenOver TakeAll(TakeOverWork& work) {
    return work.Take({OldItem::Members, OldItem::Missions, OldItem::Template, OldItem::Settings},
                     [](TakeStep) { return true; });
  }

  /// What the files of the data folder carry: "Now Now Now 3" where nothing was taken over.
  std::string Labels() const {
    return OtherConnection(Data() + "/members.mdb")
               .Query("SELECT FirstName FROM Members ORDER BY ContactID") +
           " " + OtherConnection(Data() + "/scenarios.mdb").Query("SELECT MissionName FROM Table1") + " " +
           ReadFile(Data() + "/score_card.doc").substr(8) + " " +
           IniReader(Disk, Data() + "/tessarine.ini").ReadIni("soldiering_calc", "heals", "none");
  }
  /// The same of an installation with this label.
  static std::string LabelsOf(const std::string& label) {
    return label + " " + label + " " + label + " " + std::to_string(label.size());
  }

  struct Place {
    std::string Path;
    std::string operator/(const std::string& name) const { return Path + "/" + name; }
  };

  const Place Folder;
  mutable LinuxFiles Disk;
  FakeClock Time;
  StringTable Strings{Language::English};
  SqliteEngine Databases{std::chrono::milliseconds(0)};
  JetConverter Old{Disk, JetReaderPath(), std::chrono::milliseconds(5000)};
  std::unique_ptr<Database> Members;
  std::unique_ptr<Database> Missions;
  std::vector<std::string> Questions;
  bool Answer = true;

 private:
  explicit TakeOverSite(std::unique_ptr<TemporaryFolder> folder) : TakeOverSite(folder->Path()) {
    own_ = std::move(folder);
  }

  TakenDatabase Taken(OldItem what, const std::string& name, const std::string& table,
                      std::unique_ptr<Database>& inUse) {
    const CopiedDatabase copied{.Name = name,
                                .Table = table,
                                .DefaultPath = Folder / "program/" + name + "_default.mdb",
                                .Title = OwnText::CopiedMembers,
                                .InUse = [&inUse]() -> Database& { return *inUse; }};
    const CopyWork work(
        {.Engine = Databases, .Disk = Disk, .Time = Time, .Strings = Strings, .Folder = Data() + "/backups"});
    return {.What = what,
            .Table = table,
            .DefaultPath = copied.DefaultPath,
            .InUse = copied.InUse,
            .KeepCopy = [copied, work](const KeepOn& keepOn) {
              return work.KeepPresent(copied, [&keepOn](CopyStep) { return keepOn(); });
            }};
  }

  std::unique_ptr<TemporaryFolder> own_;
};
