#pragma once

#include <optional>
#include <string>
#include <vector>

#include "core/game/GameProgress.h"
#include "core/text/StringTable.h"

/// What the status line of the main window knows about the game on the board.
struct DeskFacts {
  bool Present = false;
  int Players = 0;
  std::string Time;  ///< of the game, as the operator reads it; may be empty
  std::string Mission;
  int CountedTwice = 0;  ///< guns
  bool Unsaved = false;
  CommitCount Commits;
  bool LowestFirst = false;
  std::optional<MissionChange> Change;
  std::vector<std::string> SharedMembers;  ///< names of members who have several guns
  std::string FileOfCancel;                ///< written although the dialog was cancelled; empty if none was
  std::string UnsavedSettings;             ///< file of the settings that could not be written
  std::string KeptAt;                      ///< time at which the game was kept; empty if it was not
  std::string NotKept;                     ///< why it is not kept as it is; empty if it is
  std::string UnusableArchive;    ///< file of past games that could not be used; empty if there is none
  int CutGames = 0;               ///< past games that no longer name a member
  std::string WeeklyCopyFailure;  ///< why the weekly copy of the past games is not made; empty if it is
  bool BackupLacksRoom = false;   ///< a database was changed without a copy from before
};

/// What an entry of the status line is about.
enum class DeskTopic {
  Game,
  CountedTwice,
  Unsaved,
  Committed,
  LowestFirst,
  MissionChanged,
  SharedMembers,
  FileOfCancel,
  Settings,
  Kept,
  NotKept,
  ArchiveUnusable,
  CutGames,
  WeeklyCopyFailed,
  BackupLacksRoom
};

struct DeskEntry {
  DeskTopic Topic;
  std::string Text;
  bool IsLink = false;   ///< something can be done about it, or shown
  std::string Tip = {};  ///< what the link does
};

/// The entries of the status line, from left to right; there is always one.
std::vector<DeskEntry> DeskEntries(const DeskFacts& facts, const StringTable& strings);
