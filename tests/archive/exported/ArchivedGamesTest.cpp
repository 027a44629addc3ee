#include "archive/exported/ArchivedGames.h"

#include <gmock/gmock.h>
#include <sys/wait.h>

#include <cmath>
#include <filesystem>
#include <nlohmann/json.hpp>

#include "exports/ExportRun.h"
#include "platform/linux/LinuxFiles.h"
#include "tests/exports/CsvRows.h"
#include "tests/support/MadeDatabase.h"
#include "tests/support/OpenSession.h"
#include "tests/support/RandomGame.h"
#include "tests/support/TestDatabase.h"
#include "tests/support/Thrown.h"

namespace {

using testing::ElementsAre;
using testing::IsEmpty;

/// What a program prints; "failed" if it ends with an error.
std::string Printed(const std::string& command) {
  FILE* pipe = popen(command.c_str(), "r");
  std::string text;
  for (int letter = std::fgetc(pipe); letter != EOF; letter = std::fgetc(pipe)) {
    text += static_cast<char>(letter);
  }
  const int status = pclose(pipe);
  return WIFEXITED(status) && WEXITSTATUS(status) == 0 ? text : "failed";
}

class Archived : public testing::Test {
 protected:
  Archived() {
    std::filesystem::create_directories(venue.Folder / "program");
    WriteFile(venue.Folder / "program/games_default.mdb", MadeDatabase("games"));
    ExecuteSql(venue.MembersFile(),
               "INSERT INTO Members (ContactID, FirstName, LastName, NickName) VALUES "
               "(7, 'Ada', 'Byron', '=Mole'), (8, 'Bo', 'Li', NULL)");
    EXPECT_TRUE(venue.Open());
    games.emplace(access, session, venue.Strings);
  }

  /// A game of 20 players, members 7 and 8 among them.
  std::int64_t Keep(const std::string& played, unsigned seed = 1) {
    session.Game().Clear();
    FillRandomly(session.Game(), 20, seed);
    session.Game().DataPresent = true;
    session.Game().GameDate = "the \"" + played + "\"";
    int member = 7;
    for (Player& player : session.Game().Players) {
      player.MemberIndex = player.Active && member <= 8 ? member++ : 0;
    }
    session.CalculateScores();
    return access.Archive().Keep({.Game = session.Game(),
                                  .Mission = "-1, \"Flag\"; 旗",
                                  .Played = played,
                                  .Factors = session.Factors()});
  }

  /// The bytes of an export of these games.
  std::string Exported(const std::vector<std::int64_t>& ids, ExportFormat format,
                       const PersonalData& personal = {}) {
    const std::string path = venue.Folder / "out";
    const auto file = venue.Disk.BeginReplace(path, FileReaders::ThisUser);
    const ExportOutcome outcome =
        ExportPastGames(*games, ids, {.Format = format, .Csv = {}, .Personal = personal}, venue.Strings,
                        *file, [](double) { return true; });
    EXPECT_TRUE(outcome.Complete);
    return ReadFile(path);
  }

  OpenSession venue;
  Session& session = venue.session;
  ArchiveAccess access{{.Session = session,
                        .Disk = venue.Disk,
                        .Engine = venue.Databases,
                        .Strings = venue.Strings,
                        .UserDataFolder = venue.Folder.Path(),
                        .ProgramFolder = venue.Folder / "program"}};
  std::optional<ArchivedGames> games;
};

constexpr PersonalData Everything{.FullNames = true, .MemberNumbers = true, .Buttons = true};

TEST_F(Archived, AreFoundByDaysWithBothEnds) {
  EXPECT_THAT(games->Of("2026-01-01", "2026-12-31"), IsEmpty());
  const std::int64_t late = Keep("2026-11-30 23:59:59", 1);
  Keep("2026-12-01 00:00:00", 2);
  Keep("2026-10-31 23:59:59", 3);
  const std::int64_t early = Keep("2026-11-01 00:00:00", 4);
  EXPECT_THAT(games->Of("2026-11-01", "2026-11-30"), ElementsAre(early, late));
  EXPECT_THAT(games->InOrder({late, 4711, early}), ElementsAre(early, late));
  EXPECT_THAT(games->InOrder({}), IsEmpty());
}

TEST_F(Archived, HaveTheSameFiguresWithAndWithoutTheirFiles) {
  std::vector<std::int64_t> ids;
  for (unsigned game = 1; game <= 230; ++game) {
    ids.push_back(Keep("2026-11-21 20:15:" + std::to_string(10 + game % 50), game));
  }
  ids = games->Of("2026-11-21", "2026-11-21");
  ASSERT_EQ(ids.size(), 230U);
  const auto whole = CsvRecords(Exported(ids, ExportFormat::Players, Everything));
  const auto figures = CsvRecords(Exported(ids, ExportFormat::Figures, Everything));
  ASSERT_EQ(whole.size(), 230U * 20);
  ASSERT_EQ(figures.size(), whole.size());
  for (std::size_t row = 0; row < figures.size(); ++row) {
    for (const auto& [column, cell] : figures[row]) {
      if (column == "accuracy" && cell == NoValue) {
        EXPECT_TRUE(std::stoi(whole[row].at("shots")) <= 0 || whole[row].at("primary_damage") == "0");
      } else if (column == "accuracy") {  // of which game files hold seven digits
        const double inFile = std::stod(whole[row].at(column));
        EXPECT_NEAR(std::stod(cell), inFile, std::abs(inFile) * 1e-6);
      } else {
        ASSERT_EQ(cell, whole[row].at(column)) << row << column;
      }
    }
  }
}

TEST_F(Archived, NameMembersAsTheyAreTodayAndOthersByTheirGuns) {
  const std::int64_t id = Keep("2026-11-21 20:15:00");
  for (const ExportFormat format : {ExportFormat::Figures, ExportFormat::Players}) {
    std::vector<std::string> names;
    for (const CsvRecord& row : CsvRecords(Exported({id}, format, Everything))) {
      if (row.at("member") == NoValue) {
        EXPECT_EQ(row.at("first_name"), NoValue);
        continue;
      }
      names.push_back(row.at("member") + row.at("first_name") + row.at("last_name"));
      EXPECT_EQ(row.at("name") == "=Mole", row.at("member") == "7");
      EXPECT_TRUE(row.at("member") == "7" || row.at("name").find(' ') != std::string::npos);
    }
    EXPECT_THAT(names, testing::UnorderedElementsAre("7AdaByron", "8BoLi"));
  }
  ExecuteSql(venue.MembersFile(), "DELETE FROM Members");
  games.emplace(access, session, venue.Strings);
  for (const CsvRecord& row : CsvRecords(Exported({id}, ExportFormat::Figures, Everything))) {
    EXPECT_NE(row.at("name"), "=Mole");
    EXPECT_EQ(row.at("first_name"), NoValue);
  }
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
}

TEST_F(Archived, NameGuestsAsTheyWereInTheGame) {
  const std::int64_t id = Keep("2026-11-21 20:15:00");
  const auto names = [&](ExportFormat format) {
    std::map<std::string, std::string> byPlayer;
    for (const CsvRecord& row : CsvRecords(Exported({id}, format, Everything))) {
      byPlayer[row.at("player")] = row.at("name");
    }
    return byPlayer;
  };
  OtherConnection archive(venue.Folder / "games.mdb");
  const std::string guest = archive.Query("SELECT min(PlayerIndex) FROM GamePlayers WHERE MemberID = 0");
  const std::string member = archive.Query("SELECT PlayerIndex FROM GamePlayers WHERE MemberID = 7");
  OtherConnection(venue.Folder / "games.mdb")
      .Execute("UPDATE GamePlayers SET GuestName = 'Ann' || char(10) || 'a' WHERE PlayerIndex IN (" + guest +
               ", " + member + ")");
  for (const ExportFormat format : {ExportFormat::Figures, ExportFormat::Players}) {
    EXPECT_EQ(names(format).at(guest), "Anna");
    EXPECT_EQ(names(format).at(member), "=Mole");
  }
  EXPECT_THAT(Exported({id}, ExportFormat::Json), testing::HasSubstr("Anna"));
  EXPECT_THAT(Exported({id}, ExportFormat::Page), testing::HasSubstr("Anna"));
  OtherConnection(venue.Folder / "games.mdb").Execute("ALTER TABLE GamePlayers DROP COLUMN GuestName");
  for (const ExportFormat format : {ExportFormat::Figures, ExportFormat::Players}) {
    EXPECT_EQ(names(format).at(guest), GunName(session.Game(), std::stoi(guest)));
  }
}

TEST_F(Archived, TellNoNameThatTheOperatorHides) {
  const std::int64_t id = Keep("2026-11-21 20:15:00");
  OtherConnection archive(venue.Folder / "games.mdb");
  archive.Execute("UPDATE GamePlayers SET GuestName = 'Ann' WHERE MemberID = 0");
  HiddenNames hidden(venue.Disk, venue.Folder / "hidden");
  games.emplace(access, session, venue.Strings, &hidden);
  EXPECT_THAT(Exported({id}, ExportFormat::Json), testing::HasSubstr("Ann"));
  hidden.Hide({.Member = 7});
  hidden.Hide({.GuestName = "Ann"});
  for (const ExportFormat format : {ExportFormat::Figures, ExportFormat::Players}) {
    for (const CsvRecord& row : CsvRecords(Exported({id}, format))) {
      EXPECT_EQ(row.at("name"), GunName(session.Game(), std::stoi(row.at("player"))));
    }
  }
  for (const ExportFormat format : {ExportFormat::Hits, ExportFormat::Json, ExportFormat::Page}) {
    const std::string file = Exported({id}, format);
    EXPECT_THAT(file, testing::Not(testing::HasSubstr("Ann")));
    EXPECT_THAT(file, testing::Not(testing::HasSubstr("Mole")));
  }
}

TEST_F(Archived, ThatAreDamagedOrDeletedAreLeftOut) {
  const std::int64_t good = Keep("2026-11-21 20:15:00", 1);
  const std::int64_t damaged = Keep("2026-11-21 20:16:00", 2);
  ExecuteSql(venue.Folder / "games.mdb", "UPDATE sqlar SET data = x'00' WHERE name LIKE '%000002%'");
  const auto file = venue.Disk.BeginReplace(venue.Folder / "out", FileReaders::AsBefore);
  const ExportOutcome outcome =
      ExportPastGames(*games, {good, damaged, 4711}, {}, venue.Strings, *file, [](double) { return true; });
  EXPECT_EQ(outcome.Written, 1U);
  EXPECT_EQ(outcome.LeftOut, 2U);
  access.Archive().Delete({good}, "2026-11-22 10:00:00");
  EXPECT_THAT(CsvRecords(Exported({good}, ExportFormat::Figures)), IsEmpty());
}

TEST_F(Archived, AreReadByOtherPrograms) {
  const std::vector<std::int64_t> ids = {Keep("2026-11-21 20:15:00", 1), Keep("2026-11-21 20:16:00", 2)};
  const std::string path = venue.Folder / "out";
  const std::string players =
      "import csv,sys\n"
      "rows=list(csv.DictReader(open(sys.argv[1],encoding=\"utf-8-sig\",newline=\"\")))\n"
      "print(len(rows), sum(int(r[\"soldiering\"]) for r in rows), rows[0][\"game_date\"], "
      "sorted({r[\"mission\"] for r in rows}), sorted({r[\"game\"] for r in rows}))";
  WriteFile(venue.Folder / "players.py", players);
  const std::string sum =
      OtherConnection(venue.Folder / "games.mdb").Query("SELECT sum(Soldiering) FROM GamePlayers");
  for (const ExportFormat format : {ExportFormat::Figures, ExportFormat::Players}) {
    Exported(ids, format);
    EXPECT_EQ(
        Printed("PYTHONIOENCODING=utf-8 python3 '" + (venue.Folder / "players.py") + "' '" + path + "'"),
        "40 " + sum + " the \"2026-11-21 20:15:00\" ['\\'-1, \"Flag\"; 旗'] ['1', '2']\n");
  }
  WriteFile(venue.Folder / "games.py",
            "import json,sys\n"
            "d=json.load(open(sys.argv[1],encoding=\"utf-8\"))\n"
            "print(d[\"format\"], len(d[\"games\"]), sum(p[\"soldiering\"] for g in d[\"games\"] for p in "
            "g[\"players\"]), d[\"games\"][1][\"mission\"])");
  Exported(ids, ExportFormat::Json);
  EXPECT_EQ(Printed("PYTHONIOENCODING=utf-8 python3 '" + (venue.Folder / "games.py") + "' '" + path + "'"),
            "tessarine-games 2 " + sum + " -1, \"Flag\"; 旗\n");
}

}  // namespace
