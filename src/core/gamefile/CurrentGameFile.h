#pragma once

#include <functional>
#include <string>
#include <utility>

#include "core/game/Game.h"
#include "platform/FileDialog.h"
#include "platform/Files.h"
#include "platform/MessageBoxes.h"

/// The file last used by Load Game and Save Game, which both remember its name.
class CurrentGameFile {
 public:
  CurrentGameFile(FileDialog& dialog, Files& files, MessageBoxes& boxes)
      : dialog_(dialog), files_(files), boxes_(boxes) {}

  /// Asks for a name and saves there, replacing an existing file. Cancel saves under the name of the last
  /// load or save, if there was one. Returns true if the game was saved. A failure throws RuntimeError and
  /// leaves the old file. If `suggestion` is not empty, the dialog shows this name, in the folder of the last
  /// save, in place of the last name; it is never remembered.
  bool SaveGame(const Game& game, const std::string& missionName, const std::string& suggestion = {});

  /// Full path of the file that the last SaveGame wrote although its dialog was cancelled; else empty.
  const std::string& SavedOnCancel() const { return savedOnCancel_; }

  /// Where suggested names are offered: the folder of the last save, or as set at the start.
  const std::string& SaveFolder() const { return saveFolder_; }
  void SetSaveFolder(std::string folder) { saveFolder_ = std::move(folder); }

  /// Asks for a game to load. Returns false, and forgets the file, if the operator cancels.
  bool AskForGame();

  /// Takes this file as if the operator had chosen it; an empty path forgets the last one.
  void Choose(std::string path) { fileName_ = std::move(path); }

  /// Local time, "YYYY-MM-DD HH:MM:SS", at which the chosen file was last changed; empty if it cannot be
  /// told.
  std::string TimeOfChange() const;

  /// Reads the chosen file into `game`, which the caller has cleared. If it is not a game file, shows a box
  /// and returns false. Otherwise behaves like ReadGameFile.
  bool LoadGame(Game& game, const std::function<void(const std::string&)>& selectMission);

 private:
  FileDialog& dialog_;
  Files& files_;
  MessageBoxes& boxes_;
  std::string fileName_;
  std::string saveFolder_;
  std::string savedOnCancel_;
};
