#pragma once

#include <chrono>
#include <filesystem>
#include <memory>
#include <string>

#include "archive/copies/CopyWork.h"
#include "platform/linux/LinuxFiles.h"
#include "platform/sqlite/SqliteDatabase.h"
#include "tests/fakes/FakeClock.h"
#include "tests/support/MadeDatabase.h"

/// A data folder with members, and copies of them.
class CopySite {
 public:
  CopySite() {
    std::filesystem::create_directories(Folder / "data");
    std::filesystem::create_directories(Folder / "program");
    WriteFile(Folder / "program/members_default.mdb", MadeDatabase("members"));
    WriteFile(MembersFile(), WithMembers("'Ann', 'Bob', 'Cid'"));
    Open();
  }

  /// The bytes of a members file with a member for each quoted name.
  static std::string WithMembers(const std::string& names) {
    std::string rows = names;
    for (std::size_t at = 0; (at = rows.find(", ", at)) != std::string::npos; at += 4) {
      rows.replace(at, 2, "), (");
    }
    return MadeDatabase("members",
                        rows.empty() ? "" : "INSERT INTO Members (FirstName) VALUES (" + rows + ")");
  }

  /// Puts a file into the folder of the copies.
  BackupCopy PutCopy(const std::string& file, const std::string& bytes) const {
    std::filesystem::create_directories(CopyFolder());
    WriteFile(CopyFolder() + "/" + file, bytes);
    return BackupCopyOf(file).value_or(BackupCopy{.File = file, .Database = "members", .Time = {}});
  }

  std::string MembersFile() const { return Folder / "data/members.mdb"; }
  std::string CopyFolder() const { return Folder / "data/backups"; }

  void Open() { InUse = Databases.OpenDatabase(MembersFile()); }

  /// First names in the members file, as another program reads them.
  std::string Names() const { return NamesIn(MembersFile()); }
  static std::string NamesIn(const std::string& path) {
    return OtherConnection(path).Query("SELECT group_concat(FirstName, ' ') FROM Members");
  }

  bool Keep(CopyStep step) {
    Steps.append(std::to_string(static_cast<int>(step)));
    return !KeepOn || KeepOn(step);
  }

  Restored Restore(const BackupCopy& copy) {
    return Work.Restore(copy, Members, [this](CopyStep step) { return Keep(step); });
  }

  TemporaryFolder Folder;
  LinuxFiles Disk;
  FakeClock Time;
  StringTable Strings{Language::English};
  SqliteEngine Databases{std::chrono::milliseconds(0)};
  std::unique_ptr<Database> InUse;
  std::string Steps;  ///< numbers of the steps that were asked about
  CopyWork::OnStep KeepOn;
  CopiedDatabase Members{.Name = "members",
                         .Table = "Members",
                         .DefaultPath = Folder / "program/members_default.mdb",
                         .Title = OwnText::CopiedMembers,
                         .InUse = [this]() -> Database& { return *InUse; }};
  CopyWork Work{
      {.Engine = Databases, .Disk = Disk, .Time = Time, .Strings = Strings, .Folder = CopyFolder()}};
};
