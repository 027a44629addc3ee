#pragma once

#include <chrono>
#include <string>
#include <utility>
#include <vector>

#include "core/game/BoardTexts.h"
#include "core/game/Session.h"
#include "platform/linux/LinuxFiles.h"
#include "platform/sqlite/SqliteDatabase.h"
#include "tests/fakes/FakeClock.h"
#include "tests/fakes/FakeMessageBoxes.h"
#include "tests/fakes/FakeOldDatabases.h"
#include "tests/support/MadeDatabase.h"
#include "tests/support/ScoredGame.h"
#include "tests/support/TemporaryFolder.h"

/// A session on a temporary data folder, with real databases and files; no mission and no member until a test
/// adds them.
class OpenSession {
 public:
  OpenSession() {
    WriteFile(ScenariosFile(), MadeDatabase("scenarios", "DELETE FROM Table1; DELETE FROM sqlite_sequence"));
    WriteFile(MembersFile(), MadeDatabase("members"));
  }

  std::string ScenariosFile() const { return Folder / "scenarios.mdb"; }
  std::string MembersFile() const { return Folder / "members.mdb"; }

  bool Open() { return session.Open({Databases, Old, Disk, Folder.Path(), Folder / "program"}); }

  /// Puts a player with that many bonus points into the game.
  Player& Play(int index, int points) {
    session.Game().DataPresent = true;
    Player& player = session.Game().Players(index);
    player.Active = true;
    player.BonusPoints = points;
    return player;
  }

  /// Cells of one column of a list as a view shows them.
  std::vector<std::string> Column(BoardList list, BoardColumn column) const {
    std::vector<std::string> cells;
    const Board& rows = session.List(list);
    cells.reserve(static_cast<std::size_t>(rows.RowCount()));
    for (int place = 0; place < rows.RowCount(); ++place) {
      cells.push_back(Texts.Cell(rows.RowAt(place), column));
    }
    return cells;
  }

  TemporaryFolder Folder;
  StringTable Strings{Language::English};
  FakeClock Time;
  FakeMessageBoxes Boxes;
  SqliteEngine Databases{std::chrono::milliseconds(50)};
  FakeOldDatabases Old;
  LinuxFiles Disk;
  Session session{Strings, Time, Boxes};
  BoardTexts Texts{session.Game(), Strings};
};
