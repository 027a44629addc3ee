#include "archive/import/GameImport.h"

#include <algorithm>
#include <string_view>
#include <utility>

#include "archive/Entries.h"
#include "archive/PlayedTime.h"
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

bool IsFaultOfDisk(int number) {
  return number == Fault::FileNotFound || number == Fault::PermissionDenied || number == Fault::PathAccess ||
         number == Fault::PathNotFound;
}

}  // namespace

GameImport::GameImport(const Parts& parts, FilesOf table)
    : parts_(parts), archive_(parts.Archive, parts.Members, parts.Strings), members_(parts.Members, table) {}

bool GameImport::Run(const std::string& folder, const OnStep& onStep) {
  bool goesOn = Search(folder, onStep);
  State state{.Done = 0, .Files = paths_.size()};
  const Breath breathe = [&] { goesOn = onStep(state) && goesOn; };
  try {
    for (; goesOn && state.Done < paths_.size(); ++state.Done) {
      ImportFile(paths_[state.Done], breathe);
      breathe();
    }
  } catch (const RuntimeError&) {
    RaiseCounterIfPossible();
    throw;
  }
  if (imported_ > 0) {
    archive_.Known().RaiseCounter();
  }
  return goesOn;
}

void GameImport::RaiseCounterIfPossible() {
  try {
    archive_.Known().RaiseCounter();
  } catch (const RuntimeError&) {
    // The first failure is the one to tell. The next check of the members raises it.
  }
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
      std::string file = std::string(path).append("/").append(name);
      if (IsGameFileName(name) && (!parts_.IsWanted || parts_.IsWanted(file))) {
        paths_.push_back(std::move(file));
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
  const std::optional<Found> found = SettleAndFind(game, played, breathe);
  const bool isDeleted = found && found->As == KnownAs::Deleted;
  if (!found || isDeleted) {
    CheckSpaceForGames(parts_.Disk, parts_.UserDataFolder, parts_.Strings);
  }
  if (isDeleted) {
    archive_.BringBack({found->GameId});
    ++broughtBack_;
  }
  if (found) {
    NoteKnown(path, *found);
    return std::nullopt;
  }
  archive_.Keep({.Game = game.Game,
                 .Mission = game.Mission,
                 .Played = played,
                 .Source = GameSource::Import,
                 .Pulls = 1,
                 .Factors = parts_.Factors});
  ++imported_;
  return std::nullopt;
}

std::optional<GameImport::Found> GameImport::SettleAndFind(GameInFile& game, const std::string& played,
                                                           const Breath& breathe) {
  using Among = GameArchive::Among;
  if (const auto same = archive_.Find(game.Game, game.Mission)) {
    return Found{KnownAs::Same, *same};
  }
  auto deleted = archive_.FindState(game.Game, game.Mission, Among::Deleted);
  breathe();
  members_.Settle(game.Game);
  if (const auto same = archive_.Find(game.Game, game.Mission)) {
    return Found{KnownAs::Same, *same};
  }
  if (const auto alike = archive_.FindAlike(game.Game, game.Mission, played, Among::Listed, breathe)) {
    return Found{KnownAs::Alike, alike->GameId};
  }
  if (!deleted) {
    deleted = archive_.FindAlike(game.Game, game.Mission, played, Among::Deleted, breathe);
  }
  breathe();
  return deleted ? std::optional(Found{KnownAs::Deleted, deleted->GameId}) : std::nullopt;
}

void GameImport::NoteKnown(const std::string& path, const Found& found) {
  KnownGameFile file{.Path = path, .As = found.As, .Played = {}, .Mission = {}};
  parts_.Archive.Statements().Query("SELECT Played, Mission FROM Games WHERE GameID = $1", {found.GameId},
                                    [&file](const SqlRow& row) {
                                      file.Played = row.Text(0);
                                      file.Mission = row.Text(1);
                                    });
  known_.push_back(std::move(file));
}
