#pragma once

#include <functional>
#include <string>

#include "core/game/Game.h"
#include "platform/FileDialog.h"
#include "platform/Files.h"
#include "platform/MessageBoxes.h"

/// The file that Load Game and Save Game were last about, whose name both keep for the next time.
class CurrentGameFile {
 public:
  CurrentGameFile(FileDialog& dialog, Files& files, MessageBoxes& boxes)
      : dialog_(dialog), files_(files), boxes_(boxes) {}

  /// Asks for a name and saves there, replacing the file. Cancel saves under the name of the last load or
  /// save, and does nothing when there is none. Returns true when the game was saved. A failure throws
  /// RuntimeError and leaves the old file.
  bool SaveGame(const Game& game, const std::string& missionName);

  /// Asks for a game to load. False when the operator cancels, which also forgets the file.
  bool AskForGame();

  /// Reads the chosen file into the cleared `game`. Returns false after a box when it is no game file;
  /// otherwise as ReadGameFile does.
  bool LoadGame(Game& game, const std::function<void(const std::string&)>& selectMission);

 private:
  FileDialog& dialog_;
  Files& files_;
  MessageBoxes& boxes_;
  std::string fileName_;
};
