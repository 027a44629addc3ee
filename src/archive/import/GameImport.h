#pragma once

#include <cstddef>
#include <cstdint>
#include <functional>
#include <optional>
#include <string>
#include <vector>

#include "archive/ArchiveRoom.h"
#include "archive/GameArchive.h"
#include "archive/import/GameFileCheck.h"
#include "archive/import/MembersOfFiles.h"
#include "core/game/SoldieringFactors.h"
#include "platform/Clock.h"
#include "platform/Database.h"
#include "platform/Files.h"

struct RefusedGameFile {
  std::string Path;
  GameFileTrouble Trouble;
};

/// How a file's game was there already, in the order of the operator's texts.
enum class KnownAs {
  Same,    ///< just as it is in the file
  Alike,   ///< but for who its players are and which of them are committed
  Deleted  ///< and was brought back
};

/// A file of a game that the archive had already, or that was in the folder twice.
struct KnownGameFile {
  std::string Path;
  KnownAs As;
  std::string Played;   ///< "YYYY-MM-DD HH:MM:SS", as the archive has it
  std::string Mission;  ///< likewise
};

/// Takes game files into the archive, each as a game of its own with the figures that stand in it. A game
/// that the archive has already is not added once more, whoever its members were taken for and whether or not
/// they were committed; if it is a deleted one, it is brought back as it was.
class GameImport {
 public:
  /// All must outlive the import.
  struct Parts {
    Database& Archive;
    Database& Members;
    Files& Disk;
    const Clock& Time;
    const StringTable& Strings;
    SoldieringFactors Factors;   ///< those of today stand in for the unknown ones of a file
    std::string UserDataFolder;  ///< on whose disk space must stay free
    /// Which of the files named "*.xml" are looked at; without it, all.
    std::function<bool(const std::string& path)> IsWanted = nullptr;
  };

  /// How far the import is.
  struct State {
    std::size_t Done = 0;
    std::size_t Files = 0;  ///< 0 while the folders are still being searched
  };

  /// Asked often; may process events. False stops the import.
  using OnStep = std::function<bool(const State& state)>;

  GameImport(const Parts& parts, FilesOf table);

  /// Imports all wanted "*.xml" in the folder and below it; symbolic links to folders are not followed.
  /// Returns false if it was stopped: what was imported by then stays, and so it does when it throws. Throws
  /// RuntimeError 61 if too little of the disk is free, otherwise as GameArchive does.
  bool Run(const std::string& folder, const OnStep& onStep);

  std::size_t Imported() const { return imported_; }
  /// Files whose game was in the archive already, or twice in the folder.
  std::size_t Known() const { return known_.size() - broughtBack_; }
  /// Games that had been deleted, and were brought back.
  std::size_t BroughtBack() const { return broughtBack_; }
  /// The files of both.
  const std::vector<KnownGameFile>& KnownFiles() const { return known_; }
  const std::vector<RefusedGameFile>& Refused() const { return refused_; }

 private:
  bool Search(const std::string& folder, const OnStep& onStep);
  void ImportFile(const std::string& path, const Breath& breathe);
  std::optional<GameFileTrouble> TakeGame(const std::string& path, const Breath& breathe);
  /// What the archive has of a file's game.
  struct Found {
    KnownAs As;
    std::int64_t GameId;
  };

  /// From now on new members get numbers above all that were imported; a failure is not told.
  void RaiseCounterIfPossible();
  /// Gives the players their members, unless the archive has the game just as it is in the file. Returns what
  /// it has of the game.
  std::optional<Found> SettleAndFind(GameInFile& game, const std::string& played, const Breath& breathe);
  void NoteKnown(const std::string& path, const Found& found);

  const Parts parts_;
  GameArchive archive_;
  MembersOfFiles members_;
  std::vector<std::string> paths_;
  std::size_t imported_ = 0;
  std::size_t broughtBack_ = 0;
  std::vector<KnownGameFile> known_;
  std::vector<RefusedGameFile> refused_;
};
