#include <algorithm>
#include <chrono>
#include <cstdio>
#include <cstdlib>
#include <filesystem>
#include <string>

#include "archive/import/GameImport.h"
#include "bench/Goals.h"
#include "bench/ManyGames.h"
#include "core/gamefile/GameFile.h"
#include "platform/linux/LinuxFiles.h"
#include "tests/fakes/FakeClock.h"
#include "tests/support/MadeDatabase.h"
#include "tests/support/RandomGame.h"
#include "tests/support/TemporaryFolder.h"

namespace {

constexpr int ManyFiles = 10'000;

std::string GameOf(int players, int number) {
  Game game{StringTable(Language::English)};
  FillRandomly(game, players, static_cast<unsigned>(number));
  if (players == PlayerCount) {  // no game can be fuller
    for (Player& player : game.Players) {
      std::fill(player.HitByPlayer.begin(), player.HitByPlayer.end(), number + 100);
    }
  }
  game.GameDate = "2026-11-21 20:15";
  return WriteGameFile(game, "Mission " + std::to_string(number % 9));
}

/// The text of one of the files: a fifth are games, the others damaged, cut off, foreign or with a wrong
/// number.
std::string FileOf(int number) {
  constexpr int players = 4;
  constexpr int everySo = 2000;
  if (number % everySo == 0) {
    return GameOf(PlayerCount, number);
  }
  std::string bytes = GameOf(number % everySo == 1 ? PlayerCount : players, number);
  switch (number % 10) {
    case 0:
    case 1:
      break;
    case 2:
    case 3:
      bytes.resize(bytes.size() / 2);
      break;
    case 4:
    case 5:
      bytes.replace(bytes.rfind("<Rank> "), 8, "<Rank>x ");
      break;
    case 6:
    case 7:
      bytes = "<html><body>" + bytes + "</body></html>";
      break;
    default:
      bytes = "nothing at all";
  }
  return bytes;
}

}  // namespace

/// bench-imports: how long the window stands still while 10,000 game files, good and bad, are imported.
int main() {
  const TemporaryFolder folder;
  const std::string files = folder / "files";
  std::filesystem::create_directory(files);
  for (int number = 0; number < ManyFiles; ++number) {
    WriteFile(files + "/" + std::to_string(number) + ".xml", FileOf(number));
  }
  MakeArchive(folder / "games.mdb");
  WriteFile(folder / "members.mdb", MadeDatabase("members"));
  SqliteEngine engine;
  const auto archive = engine.OpenDatabase(folder / "games.mdb");
  const auto members = engine.OpenDatabase(folder / "members.mdb");
  LinuxFiles disk;
  const FakeClock clock;
  const StringTable strings(Language::English);
  GameImport import({.Archive = *archive,
                     .Members = *members,
                     .Disk = disk,
                     .Time = clock,
                     .Strings = strings,
                     .Factors = {},
                     .UserDataFolder = folder.Path()},
                    FilesOf::OtherTable);
  using Stopwatch = std::chrono::steady_clock;
  const auto begun = Stopwatch::now();
  auto last = begun;
  std::chrono::duration<double, std::micro> longest{0};
  import.Run(files, [&](const GameImport::State&) {
    const auto now = Stopwatch::now();
  longest = std::max<std::chrono::duration<double, std::micro>>(longest, now - last);
  last = now;
  return true;
});
const double seconds = std::chrono::duration<double>(Stopwatch::now() - begun).count();
if (import.Imported() + import.Refused().size() != std::size_t{ManyFiles} ||
    import.Imported() < ManyFiles / 6) {
  std::abort();
}
constexpr double limit = 100'000;
const bool met = ReportGoal("longest pause in an import of 10,000 files / 100 ms", longest.count() / limit, 1,
                            TimesText(longest.count(), limit) + ", " + std::to_string(import.Imported()) +
                                " games in " + std::to_string(static_cast<int>(seconds)) + " s");
return met ? 0 : 1;
}
