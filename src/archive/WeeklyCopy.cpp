#include "archive/WeeklyCopy.h"

#include <algorithm>

#include "archive/ArchiveCopies.h"
#include "archive/Entries.h"
#include "platform/RuntimeError.h"

namespace {

constexpr std::size_t WeeklyCopiesThatStay = 2;
constexpr std::int64_t SecondsOfWeek = std::int64_t{7} * 24 * 3600;

std::vector<BackupCopy> WeeklyCopiesIn(const Files& disk, const std::string& userDataFolder) {
  std::vector<BackupCopy> copies = ArchiveCopies(disk, userDataFolder);
  std::erase_if(copies, [](const BackupCopy& copy) { return copy.Kind != CopyKind::Weekly; });
  return copies;
}

}  // namespace

bool WeeklyCopy::IsDue() const {
  const std::int64_t now = SecondsOf(parts_.Time.Now());
  const std::vector<BackupCopy> copies = WeeklyCopiesIn(parts_.Disk, parts_.UserDataFolder);
  // One from the future tells that the computer's clock was wrong, not that there is no need of a copy.
  return std::none_of(copies.begin(), copies.end(), [now](const BackupCopy& copy) {
    const std::int64_t made = SecondsOf(copy.Time);
    return made <= now && now - made < SecondsOfWeek;
  });
}

bool WeeklyCopy::Step(Database& archive) {
  try {
    if (!copy_) {
      Begin(archive);
    }
    if (!copy_->Step()) {
      return false;
    }
    if (!parts_.Disk.FileExists(partPath_)) {  // somebody deleted what was not whole
      Stop();
      return false;
    }
    Finish(archive.Path());
    return true;
  } catch (const RuntimeError& error) {
    Stop();
    if (error.Number() == Fault::UnrecognizedDatabase) {
      throw RuntimeError(error.Number(), parts_.Strings.Text(OwnText::WeeklyCopyDamaged));
    }
    throw;
  }
}

void WeeklyCopy::Begin(Database& archive) {
  const std::string folder = BackupFolderIn(parts_.UserDataFolder);
  if (!parts_.Disk.FolderExists(folder)) {
    parts_.Disk.CreateFolder(folder);
  }
  if (parts_.Disk.FreeSpace(folder) < parts_.Disk.FileLen(archive.Path()) + RoomForOthers) {
    throw RuntimeError(Fault::DiskFull, parts_.Strings.Text(OwnText::WeeklyCopyNeedsRoom));
  }
  partPath_ = UnfinishedWeeklyCopy(archive.Path(), parts_.UserDataFolder);
  DeletePart();  // a crash may have left one
  copy_ = archive.BeginCopy(partPath_);
}

void WeeklyCopy::Finish(const std::string& path) {
  copy_.reset();
  const std::string folder = BackupFolderIn(parts_.UserDataFolder);
  const std::string file = path.substr(path.rfind('/') + 1);
  const std::string name = file.substr(0, file.rfind('.'));
  const std::string made = FreeCopyName(parts_.Disk, folder, name, parts_.Time.Now(), CopyKind::Weekly);
  parts_.Disk.Rename(partPath_, folder + "/" + made);
  partPath_.clear();
  DeleteOldest(made);
}

void WeeklyCopy::DeleteOldest(const std::string& made) {
  std::vector<BackupCopy> others = WeeklyCopiesIn(parts_.Disk, parts_.UserDataFolder);
  // Those of an archive that was damaged, so that another one began, are all that is left of it.
  const std::optional<BackupCopy> copied = BackupCopyOf(made);
  std::erase_if(others, [&](const BackupCopy& copy) {
    return copy.File == made || !copied || copy.Database != copied->Database;
  });
  for (std::size_t i = WeeklyCopiesThatStay - 1; i < others.size(); ++i) {
    parts_.Disk.Delete(BackupFolderIn(parts_.UserDataFolder).append("/").append(others[i].File));
  }
}

void WeeklyCopy::DeletePart() {
  if (!partPath_.empty() && parts_.Disk.FileExists(partPath_)) {
    parts_.Disk.Delete(partPath_);
  }
}

void WeeklyCopy::Stop() noexcept {
  copy_.reset();
  try {
    DeletePart();
  } catch (const RuntimeError&) {  // nobody reads it, and the next copy takes its place
  }
  partPath_.clear();
}
