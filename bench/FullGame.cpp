#include "bench/FullGame.h"

#include <sqlite3.h>
#include <unistd.h>

#include <cstdio>
#include <cstdlib>
#include <fstream>
#include <iterator>

namespace {

void MakeDatabase(const std::string& path, const std::string& script, const std::string& more) {
  std::ifstream file(std::string(TESSARINE_RESOURCES) + "/" + script);
  const std::string sql = std::string{std::istreambuf_iterator<char>(file), {}} + more;
  sqlite3* handle = nullptr;
  sqlite3_open(path.c_str(), &handle);
  if (sqlite3_exec(handle, sql.c_str(), nullptr, nullptr, nullptr) != SQLITE_OK) {
    std::fprintf(stderr, "%s: %s\n", script.c_str(), sqlite3_errmsg(handle));
    std::abort();
  }
  sqlite3_close(handle);
}

std::string DallasIdOf(int member) {
  char text[17];
  std::snprintf(text, sizeof text, "%016X", static_cast<unsigned>(member));
  return text;
}

/// A player's member; the members of different players are far apart in the table.
int MemberOf(int index, int members) {
  return index * (members / PlayerCount);
}

}  // namespace

void FillCompletely(Game& game) {
  for (int index = 1; index <= PlayerCount; ++index) {
    Player& player = game.Players(index);
    player.Active = true;
    player.ShotCount = 1000 + index;
    player.HealCount = index % 7;
    player.DeathCount = index % 13;
    player.AmmoAddCount = index % 5;
    player.PrimaryDamage = 10;
    for (int shooter = 1; shooter <= PlayerCount; ++shooter) {
      player.HitByPlayer(shooter) = 5 + (index * 31 + shooter * 17) % 90;
    }
  }
  game.DataPresent = true;
}

void MakeMissions(const std::string& path, int missions) {
  std::filesystem::remove(path);
  MakeDatabase(
      path, "scenarios_default.sql",
      "DELETE FROM Table1; WITH RECURSIVE n(i) AS (SELECT 1 UNION ALL SELECT i + 1 FROM n WHERE i < " +
          std::to_string(missions) +
          ") INSERT INTO Table1 (MissionName, MissionDescription) SELECT 'Mission ' || i, 'What to do' FROM "
          "n;");
}

void MakeMembers(const std::string& path, int members) {
  MakeDatabase(path, "members_default.sql",
               "WITH RECURSIVE n(i) AS (SELECT 1 WHERE " + std::to_string(members) +
                   " > 0 UNION ALL SELECT i + 1 FROM n WHERE i < " + std::to_string(members) +
                   ") INSERT INTO Members (ContactID, DallasID, FirstName, LastName, NickName, City) "
                   "SELECT i, printf('%016X', i), 'First' || i, 'Last' || i, "
                   "iif(i % 2, 'Nick' || i, NULL), 'Somewhere' FROM n;");
}

class FullGame::NoBoxes : public MessageBoxes {
 public:
  BoxAnswer Show(const std::string& text, const std::string&, BoxIcon, BoxButtons) override {
    std::fprintf(stderr, "%s\n", text.c_str());
    std::abort();
  }
};

FullGame::FullGame(int members) : boxes_(std::make_unique<NoBoxes>()) {
  std::string pattern = (std::filesystem::temp_directory_path() / "tessarine-bench-XXXXXX").string();
  folder_ = mkdtemp(pattern.data());
  MakeDatabase(folder_ / "scenarios.mdb", "scenarios_default.sql", "");
  MakeMembers(folder_ / "members.mdb", members);
  FillCompletely(game);
  if (members > 0) {
    for (int index = 1; index <= PlayerCount; ++index) {
      game.Players(index).MemberIndex = MemberOf(index, members);
      game.Players(index).DallasID = DallasIdOf(MemberOf(index, members));
    }
  }
  dbScenarios_ = engine_.OpenDatabase(folder_ / "scenarios.mdb");
  dbMembers_ = engine_.OpenDatabase(folder_ / "members.mdb");
  rsScenarios_ = dbScenarios_->OpenRecordset("Table1");
  rsMembers_ = dbMembers_->OpenRecordset("Members");
  Missions = std::make_unique<MissionList>(*rsScenarios_, Strings, *boxes_);
  Missions->FillMissionList();
  members_ = std::make_unique<MemberLookup>(*rsMembers_, *boxes_);
  analysis_ = std::make_unique<ScoreAnalysis>(game, factors_, *Missions, *members_, players_, teams_);
}

FullGame::~FullGame() {
  rsScenarios_.reset();
  rsMembers_.reset();
  std::filesystem::remove_all(folder_);
}

void FullGame::CalculateScores() {
  const ReadScope members(*dbMembers_);
  const ReadScope missions(*dbScenarios_);
  analysis_->CalculateScores();
}

std::size_t FullGame::ShowLists() const {
  std::size_t letters = 0;
  const auto show = [&](const Board& list, int columns) {
    for (int place = 0; place < list.RowCount(); ++place) {
      for (int column = 0; column < columns; ++column) {
        letters += texts_.Cell(list.RowAt(place), static_cast<BoardColumn>(column)).size();
      }
    }
  };
  show(players_, BoardColumnCount);
  show(teams_, TeamColumnCount);
  return letters;
}

void FullGame::Unassign() {
  for (Player& player : game.Players) {
    player.MemberIndex = 0;
  }
}
