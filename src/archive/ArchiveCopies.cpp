#include "archive/ArchiveCopies.h"

#include <string_view>

namespace {

constexpr std::string_view ArchiveNames[] = {"games", "games-new"};
constexpr const char* RewrittenEnding = ".rewritten";

bool IsArchiveName(std::string_view name) {
  return name == ArchiveNames[0] || name == ArchiveNames[1];
}

/// "games" of "/home/x/games.mdb".
std::string ArchiveNameIn(const std::string& path) {
  const std::string file = path.substr(path.rfind('/') + 1);
  return file.substr(0, file.rfind('.'));
}

}  // namespace

std::string BackupFolderIn(const std::string& userDataFolder) {
  return userDataFolder + "/backups";
}

std::vector<BackupCopy> ArchiveCopies(const Files& disk, const std::string& userDataFolder) {
  std::vector<BackupCopy> copies = CopiesIn(disk, BackupFolderIn(userDataFolder));
  std::erase_if(copies, [](const BackupCopy& copy) { return !IsArchiveName(copy.Database); });
  return copies;
}

std::vector<std::string> ArchiveCopyPaths(const Files& disk, const std::string& userDataFolder) {
  std::vector<std::string> paths;
  for (const BackupCopy& copy : ArchiveCopies(disk, userDataFolder)) {
    paths.push_back(BackupFolderIn(userDataFolder).append("/").append(copy.File));
  }
  return paths;
}

void DeleteUnfinishedArchiveCopies(Files& disk, const std::string& userDataFolder) {
  for (const std::string_view name : ArchiveNames) {
    for (const char* ending : {".part", ".weekly.part"}) {
      const std::string path = BackupFolderIn(userDataFolder).append("/").append(name).append(ending);
      if (disk.FileExists(path)) {
        disk.Delete(path);
      }
    }
  }
}

void DeleteLeftArchives(Files& disk, const std::string& userDataFolder) {
  const std::string folders[] = {userDataFolder, BackupFolderIn(userDataFolder)};
  for (const std::string& folder : folders) {
    for (const std::string& name : disk.FileNames(folder)) {
      const bool isLeft = name.ends_with(".mdb.restored") || name.ends_with(RewrittenEnding);
      if (isLeft && name.starts_with(ArchiveNames[0])) {
        disk.Delete(std::string(folder).append("/").append(name));
      }
    }
  }
}

std::string RewrittenArchive(const std::string& path) {
  return path + RewrittenEnding;
}

std::string UnfinishedWeeklyCopy(const std::string& path, const std::string& userDataFolder) {
  return BackupFolderIn(userDataFolder) + "/" + ArchiveNameIn(path) + ".weekly.part";
}
