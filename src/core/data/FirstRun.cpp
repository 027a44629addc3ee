#include "core/data/FirstRun.h"

#include "core/data/UserDatabase.h"

namespace {

struct DefaultFile {
  const char* UserFile;
  const char* SourceFile;
  const char* Message;  ///< nullptr: copied silently
};

constexpr DefaultFile DefaultFiles[] = {
    {"/scenarios.mdb", "/scenarios_default.mdb",
     "User Scenario database not found, creating new database in "},
    {"/members.mdb", "/members_default.mdb", "User Member database not found, creating new database in "},
    {"/score_card.doc", "/score_card_default.doc",
     "User Score Card template not found, creating new template in "},
    {"/tessarine.ini", "/tessarine.ini", nullptr},
};

void CreateIfMissing(Files& files, const std::string& folder) {
  if (!files.FolderExists(folder)) {
    files.CreateFolder(folder);
  }
}

}  // namespace

std::string PrepareUserDataFolder(const Folders& folders, Files& files, MessageBoxes& boxes) {
  std::string folder;
  switch (folders.LocalAppData(folder)) {
    case Folders::InvalidFolderId:
      boxes.Show("An invalid folder ID was specified", DefaultBoxTitle, BoxIcon::None);
      break;
    case Folders::DoesNotExist:
      boxes.Show("The folder does not exist", DefaultBoxTitle, BoxIcon::None);
      break;
    default:
      break;
  }
  CreateIfMissing(files, folder + "/Orvalin");
  folder += UserDataSubfolder;
  CreateIfMissing(files, folder);
  for (const DefaultFile& file : DefaultFiles) {
    if (files.FileExists(folder + file.UserFile)) {
      continue;
    }
    if (file.Message != nullptr) {
      boxes.Show(file.Message + folder + ".", DatabaseBoxTitle, BoxIcon::Information);
    }
    files.Replace(folder + file.UserFile, files.Read(folders.Program() + file.SourceFile));
  }
  return folder;
}
