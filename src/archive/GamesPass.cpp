#include "archive/GamesPass.h"

#include <algorithm>
#include <string>
#include <utility>

#include "archive/PackedBytes.h"
#include "platform/Sql.h"

namespace {

/// Where a window needs no events in between: some 20 milliseconds each.
constexpr std::int64_t GamesOfAWindow = 500;
constexpr std::int64_t PackedBytesOfAStep = 24 << 10;
constexpr std::size_t MostNumbersInAQuery = 200;

/// The players of a range of games who may be one of the persons. `values` get the buttons from $3 on.
std::string ConditionOf(const GamePersons& persons, SqlValues& values) {
  std::string condition;
  if (persons.Numbers.size() > MostNumbersInAQuery) {
    condition = "MemberID <> 0";
  } else {
    condition = "MemberID IN (0";  // which is no member, but no list may be empty
    for (const std::int32_t number : persons.Numbers) {
      condition.append(", ").append(std::to_string(number));
    }
    condition += ") AND MemberID <> 0";
  }
  std::string buttons;
  for (const std::string& button : persons.GuestButtons) {
    values.emplace_back(button);
    buttons.append(buttons.empty() ? "$" : ", $").append(std::to_string(values.size()));
  }
  if (!buttons.empty()) {
    condition.append(" OR MemberID = 0 AND DallasID IN (").append(buttons).append(")");
  }
  return condition;
}

GamePersons PersonsOf(const GamesPass::Ranges& ranges) {
  GamePersons persons;
  for (const auto& [number, range] : ranges) {
    persons.Numbers.insert(number);
  }
  return persons;
}

}  // namespace

GamesPass::GamesPass(Database& archive, GamePersons persons, Task task)
    : persons_(std::move(persons)),
      task_(task),
      highest_(WholeNumber(archive.Statements(), "SELECT max(GameID) FROM Games")),
      next_(highest_) {
  common_.Last = highest_;
}

GamesPass::GamesPass(Database& archive, Task task, const Ranges& ranges)
    : persons_(PersonsOf(ranges)), task_(task), ranges_(ranges) {
  common_.Last = WholeNumber(archive.Statements(), "SELECT max(GameID) FROM Games");
  for (const auto& [number, range] : ranges) {
    if (range.First <= range.Last) {
      highest_ = std::max(highest_, std::min(range.Last, common_.Last));
    }
  }
  for (const auto& [number, range] : ranges) {
    common_.First = std::max(common_.First, range.First);
    common_.Last = std::min(common_.Last, range.Last);
  }
  next_ = highest_;
}

bool GamesPass::Step(Database& archive, GameArchive games,
                     const std::function<void(std::int64_t)>& beforeCommit) {
  Sql& sql = archive.Statements();
  if (candidates_.empty()) {
    ReadCandidates(sql);
    return !candidates_.empty() || next_ > 0;
  }
  std::size_t done = 0;
  int found = 0;
  const auto look = [&] {
    for (std::int64_t bytes = 0; done < candidates_.size() && bytes < PackedBytesOfAStep; ++done) {
      bytes += PackedBytesOf(sql, candidates_[done]);
      found += LookInto(candidates_[done], games) ? 1 : 0;
    }
  };
  if (task_ == Task::TakeOut) {
    WriteScope scope(archive);
    look();
    if (beforeCommit) {
      beforeCommit(done < candidates_.size() ? candidates_[done] : next_);
    }
    scope.Commit();
  } else {
    const ReadScope scope(archive);
    look();
  }
  candidates_.erase(candidates_.begin(), candidates_.begin() + static_cast<std::ptrdiff_t>(done));
  found_ += found;
  return !candidates_.empty() || next_ > 0;
}

bool GamesPass::LookInto(std::int64_t game, GameArchive& games) const {
  if (game >= common_.First && game <= common_.Last) {
    return games.LookForPersons(game, persons_, task_);
  }
  GamePersons persons;
  for (const auto& [number, range] : ranges_) {
    if (game >= range.First && game <= range.Last) {
      persons.Numbers.insert(persons.Numbers.end(), number);
    }
  }
  return !persons.AreNone() && games.LookForPersons(game, persons, task_);
}

/// Of the next window: the rows tell the last state only, so a game with earlier ones has to be looked into.
void GamesPass::ReadCandidates(Sql& sql) {
  const std::int64_t below = std::max<std::int64_t>(next_ - GamesOfAWindow, 0);
  SqlValues values{below, next_};
  const std::string condition = ConditionOf(persons_, values);
  sql.Query("SELECT GameID, MemberID FROM GamePlayers WHERE GameID > $1 AND GameID <= $2 AND (" + condition +
                ") ORDER BY GameID",
            values, [this](const SqlRow& row) {
              const auto number = static_cast<std::int32_t>(row.Integer(1));
              if (number == 0 || persons_.Numbers.contains(number)) {
                candidates_.push_back(row.Integer(0));
              }
            });
  sql.Query("SELECT GameID FROM GameFiles WHERE GameID > $1 AND GameID <= $2 AND State > 0", {below, next_},
            [this](const SqlRow& row) { candidates_.push_back(row.Integer(0)); });
  std::ranges::sort(candidates_, std::ranges::greater());
  candidates_.erase(std::unique(candidates_.begin(), candidates_.end()), candidates_.end());
  next_ = below;
}

double GamesPass::Done() const {
  return highest_ == 0 ? 1 : 1 - static_cast<double>(next_) / static_cast<double>(highest_);
}
