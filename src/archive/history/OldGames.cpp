#include "archive/history/OldGames.h"

#include <charconv>
#include <vector>

#include "archive/GameRows.h"
#include "platform/RuntimeError.h"

namespace {

/// Where years are written as four digits, this is before all of them.
constexpr const char* NoTime = "0";

}  // namespace

std::optional<int> YearsToKeep(const std::string& text) {
  constexpr int mostYears = 100;
  int years = 0;
  const auto [end, error] = std::from_chars(text.data(), text.data() + text.size(), years);
  const bool isWhole = error == std::errc() && end == text.data() + text.size();
  return isWhole && years >= 1 && years <= mostYears ? std::optional(years) : std::nullopt;
}

std::string YearsBefore(const std::string& now, int years) {
  constexpr std::size_t yearDigits = 4;
  int year = 0;
  std::from_chars(now.data(), now.data() + yearDigits, year);
  std::string digits = std::to_string(year - years);
  return digits.insert(0, yearDigits - digits.size(), '0') + now.substr(yearDigits);
}

int GamesPlayedBefore(Sql& archive, const std::string& time) {
  return static_cast<int>(
      WholeNumber(archive, "SELECT count(*) FROM Games WHERE Played >= $1 AND Played < $2", {NoTime, time}));
}

int DeleteGamesBefore(Database& archive, const std::string& time, int most) {
  WriteScope scope(archive);
  Sql& sql = archive.Statements();
  std::vector<std::int64_t> games;
  sql.Query("SELECT GameID FROM Games WHERE Played >= $1 AND Played < $2 ORDER BY Played LIMIT $3",
            {NoTime, time, std::int64_t{most}},
            [&games](const SqlRow& row) { games.push_back(row.Integer(0)); });
  for (const std::int64_t game : games) {
    DeleteGame(sql, game);
  }
  scope.Commit();
  return static_cast<int>(games.size());
}

bool DeleteSomeGamesBefore(ArchiveAccess& archive, std::string& time) {
  constexpr int atOnce = 5;  // some 30 milliseconds
  if (time.empty()) {
    return false;
  }
  try {
    archive.CheckSpace();
    if (DeleteGamesBefore(archive.File(), time, atOnce) == atOnce) {
      return true;
    }
    time.clear();
  } catch (const RuntimeError&) {
    // The status line tells of an archive that cannot be used.
  }
  return false;
}
