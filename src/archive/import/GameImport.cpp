#include "archive/import/GameImport.h"

#include <algorithm>
#include <string_view>

#include "archive/Entries.h"
#include "archive/GameInputs.h"
#include "archive/GameKeeper.h"
#include "archive/import/PlayedTime.h"
#include "core/gamefile/GameFile.h"
#include "platform/RuntimeError.h"
#include "platform/Sql.h"

namespace {

bool IsGameFileName(std::string_view name) {
  constexpr std::string_view ending = ".xml";
  if (name.size() < ending.size()) {
    return false;
  }
  return std::ranges::equal(name.substr(name.size() - ending.size()), ending, [](char letter, char wanted) {
    return letter == wanted || (letter >= 'A' && letter <= 'Z' && letter - 'A' + 'a' == wanted);
  });
}

/// The inputs of a game whoever its players are.
std::string InputsOfNobody(Game game, const std::string& mission) {
  for (Player& player : game.Players) {
    player.MemberIndex = 0;
    player.DallasID = NoDallasId;
  }
  return GameInputs(game, mission);
}

bool IsFaultOfDisk(int number) {
  return number == Fault::FileNotFound || number == Fault::PermissionDenied || number == Fault::PathAccess ||
         number == Fault::PathNotFound;
}

}  // namespace

void CheckSpaceForGames(const Files& disk, const std::string& userDataFolder, const StringTable& strings) {
  if (disk.FreeSpace(userDataFolder) < GameKeeper::LeastFreeSpace) {
    throw RuntimeError(Fault::DiskFull, strings.Text(OwnText::KeeperDiskFull));
  }
}

GameImport::GameImport(const Parts& parts, FilesOf table)
    : parts_(parts), archive_(parts.Archive, parts.Members, parts.Strings), members_(parts.Members, table) {}

bool GameImport::Run(const std::string& folder, const OnStep& onStep) {
  bool goesOn = Search(folder, onStep);
  State state{.Done = 0, .Files = paths_.size()};
  const Breath breathe = [&] { goesOn = onStep(state) && goesOn; };
  for (; goesOn && state.Done < paths_.size(); ++state.Done) {
    ImportFile(paths_[state.Done], breathe);
    breathe();
  }
  if (imported_ > 0) {
    archive_.Known().RaiseCounter();
  }
  return goesOn;
}

bool GameImport::Search(const std::string& folder, const OnStep& onStep) {
  std::vector<std::string> open = {folder};
  while (!open.empty()) {
    const std::string path = open.back();
    open.pop_back();
    try {
      std::vector<std::string> below = parts_.Disk.FolderNames(path);
      std::ranges::reverse(below);  // the last is searched first
      for (const std::string& name : below) {
        open.push_back(std::string(path).append("/").append(name));
      }
    } catch (const RuntimeError& error) {
      refused_.push_back({path, {.Fault = GameFileFault::Unreadable, .Line = 0, .What = error.what()}});
    }
    for (const std::string& name : parts_.Disk.FileNames(path)) {
      if (IsGameFileName(name)) {
        paths_.push_back(std::string(path).append("/").append(name));
      }
    }
    if (!onStep({.Done = paths_.size()})) {
      return false;
    }
  }
  return true;
}

void GameImport::ImportFile(const std::string& path, const Breath& breathe) {
  std::optional<GameFileTrouble> trouble;
  try {
    trouble = TakeGame(path, breathe);
  } catch (const RuntimeError& error) {
    if (!IsFaultOfDisk(error.Number()) && error.Number() != Fault::InvalidFileFormat) {
      throw;
    }
    trouble = {.Fault = GameFileFault::Unreadable, .Line = 0, .What = error.what()};
  }
  if (trouble) {
    refused_.push_back({path, *std::move(trouble)});
  }
}

std::optional<GameFileTrouble> GameImport::TakeGame(const std::string& path, const Breath& breathe) {
  if (parts_.Disk.FileLen(path) > LargestEntry) {
    constexpr std::size_t megabyte = std::size_t{1} << 20U;
    return GameFileTrouble{.Fault = GameFileFault::TooLarge, .What = std::to_string(LargestEntry / megabyte)};
  }
  GameInFile game{.Game = Game(parts_.Strings), .Mission = {}};
  if (auto trouble = ReadCheckedGame(parts_.Disk.Read(path), parts_.Strings, game, breathe)) {
    return trouble;
  }
  const std::string played = TimePlayed(game.Game.GameDate, parts_.Disk.TimeOfChange(path), parts_.Time);
  if (SettleAndFind(game, played, breathe)) {
    ++known_;
    return std::nullopt;
  }
  CheckSpaceForGames(parts_.Disk, parts_.UserDataFolder, parts_.Strings);
  archive_.Keep({.Game = game.Game,
                 .Mission = game.Mission,
                 .Played = played,
                 .Source = GameSource::Import,
                 .Pulls = 1,
                 .Factors = parts_.Factors});
  ++imported_;
  return std::nullopt;
}

bool GameImport::SettleAndFind(GameInFile& game, const std::string& played, const Breath& breathe) {
  if (archive_.Find(game.Game, game.Mission)) {
    return true;
  }
  breathe();
  members_.Settle(game.Game);
  const bool isKnown = archive_.Find(game.Game, game.Mission) || IsKnownWithOthers(game, played, breathe);
  breathe();
  return isKnown;
}

bool GameImport::IsKnownWithOthers(const GameInFile& game, const std::string& played, const Breath& breathe) {
  constexpr std::size_t dayLength = 10;
  const std::string day = played.substr(0, dayLength);
  const auto players = std::ranges::count_if(game.Game.Players, &Player::Active);
  std::vector<std::int64_t> candidates;
  parts_.Archive.Statements().Query(
      "SELECT GameID FROM Games WHERE Mission = $1 AND Played >= $2 AND Played <= $3 AND DateText = $4 "
      "AND Players = $5 AND RedTotal = $6 AND BlueTotal = $7 AND YellowTotal = $8 AND Deleted IS NULL",
      {game.Mission, day, day + " 24", game.Game.GameDate, std::int64_t{players},
       std::int64_t{game.Game.TeamTotals(1)}, std::int64_t{game.Game.TeamTotals(2)},
       std::int64_t{game.Game.TeamTotals(3)}},
      [&candidates](const SqlRow& row) { candidates.push_back(row.Integer(0)); });
  if (candidates.empty()) {
    return false;
  }
  const std::string inputs = InputsOfNobody(game.Game, game.Mission);
  return std::ranges::any_of(candidates, [&](std::int64_t candidate) {
    breathe();
    GameInFile kept{.Game = Game(parts_.Strings), .Mission = {}};
    try {
      return !ReadCheckedGame(archive_.FileOf(candidate), parts_.Strings, kept, breathe) &&
             InputsOfNobody(kept.Game, kept.Mission) == inputs;
    } catch (const RuntimeError& error) {
      if (error.Number() != Fault::InvalidFileFormat && error.Number() != Fault::FileNotFound) {
        throw;
      }
      return false;  // nobody can tell any more
    }
  });
}
