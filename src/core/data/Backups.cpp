#include "core/data/Backups.h"

#include <string_view>
#include <utility>

#include "core/data/DatedFiles.h"
#include "core/text/Filled.h"
#include "platform/RuntimeError.h"

namespace {

constexpr std::size_t MostCopies = 10;
constexpr std::uint64_t RoomForGames = std::uint64_t{32} << 20U;
constexpr std::string_view Extension = ".mdb";

/// "members" of "/home/x/members.mdb".
std::string NameIn(const std::string& path) {
  const std::string file = path.substr(path.rfind('/') + 1);
  return file.substr(0, file.size() - Extension.size());
}

}  // namespace

void Backups::Guard(Database& database, const std::string& path) {
  database.BeforeChange([this, &database, path] { return TryCopy(database, path); });
}

bool Backups::CopyNow(Database& database, const std::string& path, const KeepOn& keepOn) {
  if (!HasRoomFor(path)) {
    throw RuntimeError(Fault::DiskFull);
  }
  return Copy(database, NameIn(path), keepOn);
}

bool Backups::TryCopy(Database& database, const std::string& path) {
  if (copied_.contains(NameIn(path))) {
    return true;
  }
  try {
    lacksRoom_ = !HasRoomFor(path);
    if (lacksRoom_) {
      return false;
    }
    Copy(database, NameIn(path), nullptr);
  } catch (const RuntimeError& error) {
    // Another program has locked the file, so the change itself will fail too; the next change tries again.
    if (error.Number() == Fault::DatabaseLocked) {
      return false;
    }
    failure_ = Filled(strings_.Text(OwnText::BackupFailed), {path, error.what()});
  }
  return true;
}

bool Backups::HasRoomFor(const std::string& path) const {
  try {
    const std::string folder = path.substr(0, path.rfind('/'));
    return disk_.FreeSpace(folder) >= disk_.FileLen(path) + RoomForGames;
  } catch (const RuntimeError&) {
    return true;  // the copy itself will tell
  }
}

bool Backups::Copy(Database& database, const std::string& name, const KeepOn& keepOn) {
  if (!disk_.FolderExists(folder_)) {
    disk_.CreateFolder(folder_);
  }
  const std::string part = folder_ + "/" + name + ".part";
  const DatedFiles copies(disk_, folder_, name, std::string(Extension), MostCopies);
  const std::string newest = copies.NameAt(time_.Now());
  const auto deletePart = [&] {
    if (disk_.FileExists(part)) {
      disk_.Delete(part);
    }
  };
  deletePart();  // a crash may have left one
  try {
    if (!keepOn) {
      database.CopyTo(part);
    } else if (!database.CopyInSteps(part, keepOn)) {
      deletePart();
      return false;
    }
    disk_.Rename(part, folder_ + "/" + newest);
  } catch (const RuntimeError&) {
    deletePart();
    throw;
  }
  copied_.insert(name);
  copies.DeleteOldest(newest);
  return true;
}

std::string Backups::TakeFailure() {
  return std::exchange(failure_, {});
}
