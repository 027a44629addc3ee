#include "archive/history/ForgetMember.h"

#include <algorithm>
#include <memory>
#include <utility>

#include "archive/ArchiveCopies.h"
#include "archive/ArchiveFile.h"
#include "archive/GameArchive.h"
#include "archive/GameKeeper.h"
#include "archive/GamesPass.h"
#include "archive/PendingCuts.h"
#include "archive/history/PrintedRanking.h"
#include "core/text/Filled.h"
#include "platform/RuntimeError.h"

namespace {

/// How much of a file's work the games are; the rest is writing it anew.
constexpr double ShareOfGames = 0.7;

std::string NameOfFile(const std::string& path) {
  return path.substr(path.rfind('/') + 1);
}

/// Keeps an archive that was set aside as damaged from being used again because it is changed here.
class StillAside {
 public:
  StillAside(Files& disk, const std::string& path) : disk_(disk), path_(path) {
    isAside_ = IsArchiveSetAside(disk, path);
    if (isAside_) {
      HoldArchiveAside(disk, path);
    }
  }
  ~StillAside() {
    try {
      if (isAside_) {
        SetArchiveAside(disk_, path_);
      }
    } catch (const RuntimeError&) {  // then it stays aside whatever becomes of it
    }
  }
  StillAside(const StillAside&) = delete;
  StillAside& operator=(const StillAside&) = delete;

 private:
  Files& disk_;
  const std::string path_;
  bool isAside_ = false;
};

/// A file that is gone at the end unless it has taken another's place.
class RewrittenFile {
 public:
  RewrittenFile(Files& disk, std::string path) : disk_(disk), path_(std::move(path)) { Delete(); }
  ~RewrittenFile() {
    try {
      Delete();
    } catch (const RuntimeError&) {  // the next Forget deletes it
    }
  }
  RewrittenFile(const RewrittenFile&) = delete;
  RewrittenFile& operator=(const RewrittenFile&) = delete;

  const std::string& Path() const { return path_; }

 private:
  void Delete() const {
    if (disk_.FileExists(path_)) {
      disk_.Delete(path_);
    }
  }

  Files& disk_;
  const std::string path_;
};

/// 0 for a file that does not tell: forgetting in it will tell why.
std::uint64_t LengthIfTold(const Files& disk, const std::string& path) noexcept {
  try {
    return disk.FileLen(path);
  } catch (const RuntimeError&) {
    return 0;
  }
}

/// How much of so many bytes a file has; it may be told wrong, since it fails on nothing.
double WrittenShare(const Files& disk, const std::string& path, std::uint64_t bytes) noexcept {
  try {
    const std::uint64_t written = disk.FileExists(path) ? disk.FileLen(path) : 0;
    return std::min(1.0,
                    static_cast<double>(written) / static_cast<double>(std::max<std::uint64_t>(bytes, 1)));
  } catch (const RuntimeError&) {
    return 0;
  }
}

}  // namespace

ForgetMember::ForgetMember(Parts parts, std::int32_t number) : parts_(std::move(parts)), number_(number) {}

std::vector<std::string> ForgetMember::Archives() const {
  std::vector<std::string> files;
  for (const char* name : {"/games.mdb", "/games-new.mdb"}) {
    if (parts_.Disk.FileExists(parts_.UserDataFolder + name)) {
      files.push_back(parts_.UserDataFolder + name);
    }
  }
  return files;
}

void ForgetMember::Identify() {
  person_.emplace(number_, parts_.DbMembers);
  std::vector<std::string> files = Archives();
  std::ranges::reverse(files);  // the one in use first
  for (const std::string& copy : ArchiveCopyPaths(parts_.Disk, parts_.UserDataFolder)) {
    files.push_back(copy);
  }
  for (const std::string& file : files) {
    try {
      person_->Read(file, parts_.Engine.OpenDatabase(file));
    } catch (const RuntimeError&) {
      // Forget tells of it when it cannot be changed either.
    }
  }
  person_->Finish();
}

std::optional<int> ForgetMember::CountGames(const OnStep& onStep) {
  Identify();
  int games = 0;
  const std::vector<std::string> files = Archives();
  for (std::size_t i = 0; i < files.size(); ++i) {
    try {
      const std::unique_ptr<Database> database = parts_.Engine.OpenDatabase(files[i]);
      GamesPass pass(*database, person_->In(files[i]), GameArchive::Task::Look);
      while (pass.Step(*database, {*database, parts_.DbMembers, parts_.Strings})) {
        const double done = (static_cast<double>(i) + pass.Done()) / static_cast<double>(files.size());
        if (!onStep({.Counting = true, .File = NameOfFile(files[i]), .Done = done})) {
          return std::nullopt;
        }
      }
      games += pass.Games();
    } catch (const RuntimeError&) {
      if (i + 1 == files.size()) {
        throw;
      }
      // One that was set aside as damaged; Forget tells of it.
    }
  }
  return games;
}

void ForgetMember::DeleteLeftFiles(std::vector<std::string>& failures) const {
  try {
    DeleteUnfinishedArchiveCopies(parts_.Disk, parts_.UserDataFolder);
    DeleteLeftArchives(parts_.Disk, parts_.UserDataFolder);
    DeletePrintedRanking(parts_.Disk, parts_.UserDataFolder);
  } catch (const RuntimeError& error) {
    failures.emplace_back(error.what());
  }
}

Forgotten ForgetMember::Forget(const OnStep& onStep) {
  Forgotten forgotten;
  DeleteLeftFiles(forgotten.Failures);
  // What is still known of a member in the archive in use finds him again after a stop.
  std::vector<std::string> files = ArchiveCopyPaths(parts_.Disk, parts_.UserDataFolder);
  for (const std::string& archive : Archives()) {
    files.push_back(archive);
  }
  bytesOfAll_ = 1;
  bytesDone_ = 0;
  for (const std::string& file : files) {
    bytesOfAll_ += LengthIfTold(parts_.Disk, file);
  }
  for (const std::string& file : files) {
    bytesOfFile_ = LengthIfTold(parts_.Disk, file);
    if (forgotten.Stopped || !ForgetIn(file, forgotten, onStep)) {
      forgotten.Stopped = true;
      forgotten.Failures.push_back(Filled(parts_.Strings.Text(OwnText::ForgetNotDone), {NameOfFile(file)}));
    }
    bytesDone_ += bytesOfFile_;
  }
  return forgotten;
}

bool ForgetMember::ForgetIn(const std::string& file, Forgotten& forgotten, const OnStep& onStep) {
  OwnText failure = OwnText::ForgetFailed;
  try {
    const StillAside aside(parts_.Disk, file);
    const std::unique_ptr<Database> database = parts_.Engine.OpenDatabase(file);
    if (!TakeOutOf(*database, file, forgotten, onStep)) {
      return false;
    }
    failure = OwnText::ForgetRestStays;
    return WriteAnew(*database, file, onStep);
  } catch (const RuntimeError& error) {
    forgotten.Failures.push_back(Filled(parts_.Strings.Text(failure), {NameOfFile(file), error.what()}));
  }
  return true;
}

bool ForgetMember::TakeOutOf(Database& database, const std::string& file, Forgotten& forgotten,
                             const OnStep& onStep) {
  const std::vector<std::string> archives = Archives();
  const bool counts = std::ranges::find(archives, file) != archives.end();
  GamesPass pass(database, person_->In(file), GameArchive::Task::TakeOut);
  int found = 0;
  bool goesOn = true;
  for (bool hasMore = true; hasMore && goesOn;) {
    CheckRoomFor(0, file);
    hasMore = pass.Step(database, {database, parts_.DbMembers, parts_.Strings});
    forgotten.Games += counts ? pass.Games() - std::exchange(found, pass.Games()) : 0;
    goesOn = Ask(onStep, file, pass.Done() * ShareOfGames) || !hasMore;
  }
  return goesOn;
}

/// Until the file is written anew, those who are no members stay known, without marks, so that they can be
/// chosen again after a stop.
bool ForgetMember::WriteAnew(Database& database, const std::string& file, const OnStep& onStep) {
  const GamePersons persons = person_->In(file);
  {
    WriteScope scope(database);
    KnownMembers known(database, parts_.DbMembers);
    for (const std::int32_t number : persons.Numbers) {
      if (known.Read({number})[number] == MemberMark{}) {
        known.Blank(number);
      } else {
        known.Forget(number);
      }
    }
    PendingCuts(database).Drop(persons.Numbers);
    scope.Commit();
  }
  CheckRoomFor(parts_.Disk.FileLen(file), file);
  {
    const WritersHeld held(database);
    const RewrittenFile rewritten(parts_.Disk, RewrittenArchive(database.FilePath()));
    // By a connection of its own: the other one keeps others from writing.
    const auto keepOn = [&] {
      const double ofFile = WrittenShare(parts_.Disk, rewritten.Path(), bytesOfFile_);
      return Ask(onStep, file, ShareOfGames + (1 - ShareOfGames) * ofFile);
    };
    if (!parts_.Engine.OpenDatabase(file)->RewriteTo(rewritten.Path(), keepOn)) {
      return false;
    }
    parts_.Disk.TakePlace(rewritten.Path(), database.FilePath());
    Ask(onStep, file, 1);  // a stop comes too late for this file
  }
  const std::unique_ptr<Database> anew = parts_.Engine.OpenDatabase(file);
  WriteScope scope(*anew);
  KnownMembers known(*anew, parts_.DbMembers);
  for (const std::int32_t number : persons.Numbers) {
    known.Forget(number);
  }
  scope.Commit();
  return true;
}

void ForgetMember::CheckRoomFor(std::uint64_t bytes, const std::string& file) const {
  const std::string folder = file.substr(0, file.rfind('/'));
  if (parts_.Disk.FreeSpace(folder) < bytes + GameKeeper::LeastFreeSpace) {
    throw RuntimeError(Fault::DiskFull, parts_.Strings.Text(OwnText::KeeperDiskFull));
  }
}

bool ForgetMember::Ask(const OnStep& onStep, const std::string& file, double ofFile) const {
  const double bytes = static_cast<double>(bytesDone_) + ofFile * static_cast<double>(bytesOfFile_);
  return onStep({.Counting = false,
                 .File = NameOfFile(file),
                 .Done = std::min(1.0, bytes / static_cast<double>(bytesOfAll_))});
}
