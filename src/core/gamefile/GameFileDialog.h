#pragma once

#include <functional>
#include <string>

#include "core/game/Game.h"
#include "platform/FileDialog.h"
#include "platform/Files.h"
#include "platform/MessageBoxes.h"

/// Load Game and Save Game. Both remember the last file name.
class GameFileDialog {
 public:
  GameFileDialog(FileDialog& dialog, Files& files, MessageBoxes& boxes)
      : dialog_(dialog), files_(files), boxes_(boxes) {}

  /// Asks for a name and saves there, replacing an existing file. Cancel saves under the name of the last
  /// load or save, if there was one. A failure throws RuntimeError and leaves the old file.
  void SaveGame(const Game& game, const std::string& missionName);

  /// Asks for a game to load. False if the operator cancels.
  bool AskForGame();

  /// Reads the chosen file into `game`, which the caller has cleared. If it is not a game file, shows a box
  /// and returns false. Otherwise behaves like ReadGameFile.
  bool LoadGame(Game& game, const std::function<void(const std::string&)>& selectMission);

 private:
  FileDialog& dialog_;
  Files& files_;
  MessageBoxes& boxes_;
  std::string fileName_;
};
