#include "archive/copies/CopyWork.h"

#include <algorithm>
#include <utility>

#include "core/text/Filled.h"
#include "platform/Letters.h"
#include "platform/RuntimeError.h"

namespace {

/// Copies leave this to games and settings.
constexpr std::uint64_t RoomForOthers = std::uint64_t{32} << 20U;

/// "members" of "/home/x/members.mdb".
std::string DatabaseNameIn(const std::string& path) {
  const std::string file = path.substr(path.rfind('/') + 1);
  return file.substr(0, file.rfind('.'));
}

std::string FolderOf(const std::string& path) {
  const std::size_t end = path.rfind('/');
  return end == std::string::npos ? "." : path.substr(0, std::max<std::size_t>(end, 1));
}

bool SameName(const std::string& one, const std::string& other) {
  return std::equal(one.begin(), one.end(), other.begin(), other.end(),
                    [](char a, char b) { return LowerAscii(a) == LowerAscii(b); });
}

KeepOn In(CopyStep step, const CopyWork::OnStep& keepOn) {
  return [step, &keepOn] { return keepOn(step); };
}

}  // namespace

/// A file that is being written and then becomes another. If it did not, it is deleted at the end.
class CopyWork::PartFile {
 public:
  /// At a path in a folder of the program, where one that a crash left is deleted.
  static PartFile At(Files& disk, std::string path) {
    if (disk.FileExists(path)) {
      disk.Delete(path);
    }
    return {disk, std::move(path)};
  }
  /// In a folder of the operator's, where every other file is theirs.
  static PartFile In(Files& disk, const std::string& folder) { return {disk, disk.MakeFileIn(folder)}; }
  ~PartFile() {
    try {
      if (Exists()) {
        disk_.Delete(path_);
      }
    } catch (const RuntimeError&) {  // nobody reads it, and the next one takes its place
    }
  }
  PartFile(const PartFile&) = delete;
  PartFile& operator=(const PartFile&) = delete;

  const std::string& Path() const { return path_; }
  bool Exists() const { return disk_.FileExists(path_); }
  /// True also where the disk cannot tell.
  bool MayBeGone() const {
    try {
      return !Exists();
    } catch (const RuntimeError&) {
      return true;
    }
  }

 private:
  PartFile(Files& disk, std::string path) : disk_(disk), path_(std::move(path)) {}

  Files& disk_;
  const std::string path_;
};

std::string CopyWork::NameOfNow(const CopiedDatabase& database) const {
  return FreeCopyName(parts_.Disk, parts_.Folder, DatabaseNameIn(database.InUse().Path()), parts_.Time.Now(),
                      CopyKind::ByHand);
}

int CopyWork::RowsIn(const BackupCopy& copy, const CopiedDatabase& database) const {
  return parts_.Engine.OpenDatabase(PathOf(copy))->OpenRecordset(database.Table)->RecordCount();
}

std::optional<std::string> CopyWork::CopyNow(const CopiedDatabase& database, const OnStep& keepOn) const {
  return Keep(database.InUse().Path(), CopyKind::ByHand, CopyStep::Copying, keepOn);
}

std::optional<std::string> CopyWork::KeepPresent(const CopiedDatabase& database, const OnStep& keepOn) const {
  return Keep(database.InUse().Path(), CopyKind::BeforeRestore, CopyStep::KeepingPresent, keepOn);
}

bool CopyWork::IsDataInUse(const std::string& target, const std::vector<CopiedDatabase>& databases) const {
  const std::string folder = FolderOf(parts_.Folder);
  const auto isOf = [&](const CopiedDatabase& database) {
    const std::string path = folder + "/" + database.Name;  // which may be a link to another folder
    return parts_.Disk.IsSame(target, path + ".mdb") || parts_.Disk.IsSame(target, path + "-new.mdb");
  };
  return parts_.Disk.IsSame(FolderOf(target), folder) ||
         std::any_of(databases.begin(), databases.end(), isOf);
}

bool CopyWork::CopyToFile(const std::string& path, const std::string& target, const OnStep& keepOn) const {
  const std::unique_ptr<Database> source = parts_.Engine.OpenDatabase(path);
  const PartFile part = PartFile::In(parts_.Disk, FolderOf(target));
  if (!source->CopyInSteps(part.Path(), In(CopyStep::Copying, keepOn))) {
    return false;
  }
  parts_.Disk.Rename(part.Path(), target);
  return true;
}

Restored CopyWork::Restore(const BackupCopy& copy, const CopiedDatabase& database,
                           const OnStep& keepOn) const {
  Restored restored;
  try {
    restored.What = PutCopyInPlace(copy, database, keepOn, restored) ? Restored::Done : Restored::Stopped;
  } catch (const RuntimeError& error) {
    restored.Reason = error.what();
    if (restored.What != Restored::Uncertain) {
      restored.What = Restored::Refused;
    }
  }
  const bool unchanged = restored.What == Restored::Refused || restored.What == Restored::Stopped;
  if (unchanged && !restored.KeptAs.empty()) {
    DeleteCopy(std::exchange(restored.KeptAs, {}));
  }
  return restored;
}

void CopyWork::DeleteCopy(const std::string& file) const {
  try {
    parts_.Disk.Delete(parts_.Folder + "/" + file);
  } catch (const RuntimeError&) {  // a copy more than needed does no harm
  }
}

bool CopyWork::PutCopyInPlace(const BackupCopy& copy, const CopiedDatabase& database, const OnStep& keepOn,
                              Restored& restored) const {
  const std::unique_ptr<Database> source = parts_.Engine.OpenDatabase(PathOf(copy));
  if (!source->CheckWhole(In(CopyStep::Checking, keepOn))) {
    return false;
  }
  CheckColumns(*source, database);
  Database& inUse = database.InUse();
  const WritersHeld held(inUse);  // or what others write now would be lost
  const std::string file = inUse.FilePath();
  CheckRoom(source->Path(), FolderOf(file));
  const std::optional<std::string> kept = KeepPresent(database, keepOn);
  if (!kept) {
    return false;
  }
  restored.KeptAs = *kept;
  const PartFile part = PartFile::At(parts_.Disk, file + ".restored");
  if (!source->CopyInSteps(part.Path(), In(CopyStep::Copying, keepOn))) {
    return false;
  }
  try {
    parts_.Disk.TakePlace(part.Path(), file);
  } catch (const RuntimeError&) {
    if (part.MayBeGone()) {
      restored.What = Restored::Uncertain;
    }
    throw;
  }
  return true;
}

void CopyWork::CheckColumns(Database& copy, const CopiedDatabase& database) const {
  const std::vector<std::string> there = copy.ColumnNames(database.Table);
  for (const std::string& needed :
       parts_.Engine.OpenDatabase(database.DefaultPath)->ColumnNames(database.Table)) {
    if (std::none_of(there.begin(), there.end(),
                     [&needed](const std::string& name) { return SameName(name, needed); })) {
      throw RuntimeError(Fault::ItemNotFound,
                         Filled(parts_.Strings.Text(OwnText::CopyLacksColumn), {database.Table, needed}));
    }
  }
  copy.OpenRecordset(database.Table);  // a table that has no keys cannot be worked with
}

void CopyWork::CheckRoom(const std::string& path, const std::string& folder) const {
  if (parts_.Disk.FreeSpace(folder) < parts_.Disk.FileLen(path) + RoomForOthers) {
    throw RuntimeError(Fault::DiskFull, "Disk full: " + folder);
  }
}

std::optional<std::string> CopyWork::Keep(const std::string& path, CopyKind kind, CopyStep step,
                                          const OnStep& keepOn) const {
  if (!parts_.Disk.FolderExists(parts_.Folder)) {
    parts_.Disk.CreateFolder(parts_.Folder);
  }
  CheckRoom(path, parts_.Folder);
  const std::string name = DatabaseNameIn(path);
  const PartFile part = PartFile::At(parts_.Disk, parts_.Folder + "/" + name + ".part");
  // By a connection of its own: the one in use may be keeping others from writing.
  if (!parts_.Engine.OpenDatabase(path)->CopyInSteps(part.Path(), In(step, keepOn))) {
    return std::nullopt;
  }
  std::string file = FreeCopyName(parts_.Disk, parts_.Folder, name, parts_.Time.Now(), kind);
  parts_.Disk.Rename(part.Path(), parts_.Folder + "/" + file);
  return file;
}
