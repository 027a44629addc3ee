#include "takeover/OldInstallation.h"

#include <algorithm>
#include <array>
#include <string_view>

#include "platform/Letters.h"
#include "platform/RuntimeError.h"

namespace {

constexpr std::string_view GameEnding = ".xml";

bool IsNamed(std::string_view one, std::string_view other) {
  return std::equal(one.begin(), one.end(), other.begin(), other.end(),
                    [](char a, char b) { return LowerAscii(a) == LowerAscii(b); });
}

/// Names of the folders in one that may be unreadable, as others' folders on a disk are.
std::vector<std::string> FoldersIn(const Files& disk, const std::string& folder) {
  try {
    return disk.FolderNames(folder);
  } catch (const RuntimeError&) {
    return {};
  }
}

/// Adds the folders that `pattern` describes below `folder`: names with "/" between them, "*" for any one.
void AddMatches(const Files& disk, const std::string& folder, std::string_view pattern,
                std::vector<std::string>& matches) {
  if (pattern.empty()) {
    matches.push_back(folder);
    return;
  }
  const std::size_t end = std::min(pattern.find('/'), pattern.size());
  const std::string_view name = pattern.substr(0, end);
  const std::string_view rest = pattern.substr(std::min(end + 1, pattern.size()));
  for (const std::string& found : FoldersIn(disk, folder)) {
    if (name == "*" || IsNamed(found, name)) {
      AddMatches(disk, std::string(folder).append("/").append(found), rest, matches);
    }
  }
}

OldInstallation InstallationIn(const Files& disk, const std::string& folder) {
  return {.Folder = folder,
          .Members = FileInFolder(disk, folder, "members.mdb"),
          .Missions = FileInFolder(disk, folder, "scenarios.mdb"),
          .Template = FileInFolder(disk, folder, "score_card.doc"),
          .Settings = FileInFolder(disk, folder, "tessarine.ini"),
          .GamesFolder = folder};
}

bool HoldsAnything(const OldInstallation& old) {
  return !(old.Members.empty() && old.Missions.empty() && old.Template.empty() && old.Settings.empty());
}

/// When its members, or what else it has, were last changed.
std::string LastUse(const Files& disk, const OldInstallation& old) {
  for (const std::string* path : {&old.Members, &old.Missions, &old.Settings, &old.Template}) {
    try {
      if (!path->empty()) {
        return disk.TimeOfChange(*path);
      }
    } catch (const RuntimeError&) {  // the next one tells as much
    }
  }
  return {};
}

void AddGameFile(const Files& disk, const std::string& path, OldGameFiles& games) {
  if (!MayBeOldGame(disk, path)) {
    return;
  }
  ++games.Count;
  try {
    const std::string changed = disk.TimeOfChange(path);
    games.First = games.First.empty() ? changed : std::min(games.First, changed);
    games.Last = std::max(games.Last, changed);
  } catch (const RuntimeError&) {  // its time alone is unknown
  }
}

}  // namespace

bool MayBeOldGame(const Files& disk, const std::string& path) {
  constexpr std::size_t startOfFile = 512;
  try {
    return disk.ReadPart(path, 0, startOfFile).find("<GameData") != std::string::npos;
  } catch (const RuntimeError&) {
    return true;
  }
}

std::string FileInFolder(const Files& disk, const std::string& folder, const std::string& name) {
  std::string found;
  for (const std::string& file : disk.FileNames(folder)) {
    if (file == name || (found.empty() && IsNamed(file, name))) {
      found = file;
    }
  }
  return found.empty() ? found : folder + "/" + found;
}

std::optional<OldInstallation> FindOldInstallation(const Files& disk, const std::string& chosen) {
  // From the nearest on. Those of whole disks may match for several persons: the latest in use counts.
  constexpr std::array<std::string_view, 10> places = {
      "",
      "Tessarine",
      "Orvalin/Tessarine",
      "Local/Orvalin/Tessarine",
      "AppData/Local/Orvalin/Tessarine",
      ".local/share/Orvalin/Tessarine",
      "*/AppData/Local/Orvalin/Tessarine",
      "Users/*/AppData/Local/Orvalin/Tessarine",
      "Documents and Settings/*/Local Settings/Application Data/Orvalin/Tessarine",
      "home/*/.local/share/Orvalin/Tessarine"};
  constexpr std::size_t placesOfCopies = 3;  // whose game files may lie beside the data folder
  disk.FolderNames(chosen);
  for (std::size_t place = 0; place < places.size(); ++place) {
    std::vector<std::string> folders;
    AddMatches(disk, chosen, places[place], folders);
    std::optional<OldInstallation> latest;
    for (const std::string& folder : folders) {
      OldInstallation old = InstallationIn(disk, folder);
      if (HoldsAnything(old) && (!latest || LastUse(disk, *latest) < LastUse(disk, old))) {
        latest = std::move(old);
      }
    }
    if (latest) {
      latest->GamesFolder = place < placesOfCopies ? chosen : latest->Folder;
      return latest;
    }
  }
  return std::nullopt;
}

std::optional<OldGameFiles> CountGameFiles(const Files& disk, const std::string& folder,
                                           const std::function<bool()>& keepOn) {
  OldGameFiles games;
  std::vector<std::string> folders = {folder};
  while (!folders.empty()) {
    const std::string next = std::move(folders.back());
    folders.pop_back();
    for (const std::string& file : disk.FileNames(next)) {
      if (!keepOn()) {
        return std::nullopt;
      }
      if (file.size() >= GameEnding.size() &&
          IsNamed(std::string_view(file).substr(file.size() - GameEnding.size()), GameEnding)) {
        AddGameFile(disk, std::string(next).append("/").append(file), games);
      }
    }
    for (const std::string& inside : FoldersIn(disk, next)) {
      folders.push_back(std::string(next).append("/").append(inside));
    }
  }
  return games;
}
