#include "core/data/Backups.h"

#include <algorithm>
#include <string_view>
#include <utility>
#include <vector>

#include "core/text/Filled.h"
#include "platform/Letters.h"
#include "platform/RuntimeError.h"

namespace {

constexpr std::size_t MostCopies = 10;
constexpr std::string_view Extension = ".mdb";
constexpr std::string_view DateForm = "0000-00-00-000000";

/// "members" of "/home/x/members.mdb".
std::string NameIn(const std::string& path) {
  const std::string file = path.substr(path.rfind('/') + 1);
  return file.substr(0, file.size() - Extension.size());
}

/// "YYYY-MM-DD HH:MM:SS" as part of a file name; the copies sort by it.
std::string DateInName(std::string now) {
  std::replace(now.begin(), now.end(), ' ', '-');
  now.erase(std::remove(now.begin(), now.end(), ':'), now.end());
  return now;
}

bool IsCopyOf(const std::string& name, std::string_view file) {
  if (!file.starts_with(name + "-") || !file.ends_with(Extension)) {
    return false;
  }
  file.remove_prefix(name.size() + 1);
  file.remove_suffix(Extension.size());
  return std::equal(file.begin(), file.end(), DateForm.begin(), DateForm.end(),
                    [](char letter, char form) { return form == '0' ? IsDigit(letter) : letter == form; });
}

}  // namespace

void Backups::Guard(Database& database, const std::string& path) {
  database.BeforeChange([this, &database, path] { return TryCopy(database, path); });
}

bool Backups::TryCopy(Database& database, const std::string& path) {
  try {
    Copy(database, NameIn(path));
  } catch (const RuntimeError& error) {
    // Another program has locked the file, so the change itself will fail too; the next change tries again.
    if (error.Number() == Fault::DatabaseLocked) {
      return false;
    }
    failure_ = Filled(strings_.Text(OwnText::BackupFailed), {path, error.what()});
  }
  return true;
}

void Backups::Copy(Database& database, const std::string& name) {
  if (!disk_.FolderExists(folder_)) {
    disk_.CreateFolder(folder_);
  }
  const std::string part = folder_ + "/" + name + ".part";
  const std::string newest = name + "-" + DateInName(time_.Now()) + std::string(Extension);
  const auto deletePart = [&] {
    if (disk_.FileExists(part)) {
      disk_.Delete(part);
    }
  };
  deletePart();  // a crash may have left one
  try {
    database.CopyTo(part);
    disk_.Rename(part, folder_ + "/" + newest);
  } catch (const RuntimeError&) {
    deletePart();
    throw;
  }
  DeleteOldest(name, newest);
}

// The newest stays even if the computer's clock was set back.
void Backups::DeleteOldest(const std::string& name, const std::string& newest) {
  std::vector<std::string> others;
  for (const std::string& file : disk_.FileNames(folder_)) {
    if (IsCopyOf(name, file) && file != newest) {
      others.push_back(file);
    }
  }
  for (std::size_t i = 0; i + MostCopies <= others.size(); ++i) {
    disk_.Delete(folder_ + "/" + others[i]);
  }
}

std::string Backups::TakeFailure() {
  return std::exchange(failure_, {});
}
