#pragma once

#include <functional>
#include <optional>
#include <string>
#include <vector>

#include "platform/Files.h"

/// What the data folder of an old installation can hold.
enum class OldItem { Members, Missions, Template, Settings, Games };

/// A folder with the data of an old installation. Paths are empty for what it does not hold.
struct OldInstallation {
  std::string Folder;
  std::string Members;
  std::string Missions;
  std::string Template;
  std::string Settings;
  std::string GamesFolder;  ///< game files lie here and below
};

/// Game files of an old installation.
struct OldGameFiles {
  std::size_t Count = 0;
  std::string First;  ///< local time of the earliest change, "YYYY-MM-DD HH:MM:SS"; empty without a file
  std::string Last;   ///< of the latest
};

/// Looks for an old installation's data in the folder that the operator chose, then where a copy of the data
/// folder or a whole disk has them. Names match in upper and lower case. Nothing if there are none. Throws
/// RuntimeError 70, 75 or 76 if the chosen folder cannot be read.
std::optional<OldInstallation> FindOldInstallation(const Files& disk, const std::string& chosen);

/// True for a file that begins as a game does, or that cannot be read. Old data lies among other XML files.
bool MayBeOldGame(const Files& disk, const std::string& path);

/// Counts the game files in a folder and below it; symbolic links to folders are not followed. Asks between
/// two files whether to keep on. Nothing if it was stopped. Folders that cannot be read are left out.
std::optional<OldGameFiles> CountGameFiles(const Files& disk, const std::string& folder,
                                           const std::function<bool()>& keepOn);

/// Path of the file with this name in the folder, in upper or lower case: the exact one if there are several.
/// Empty if there is none.
std::string FileInFolder(const Files& disk, const std::string& folder, const std::string& name);
