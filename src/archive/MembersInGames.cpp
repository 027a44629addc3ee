// What the archive does about members in its games: numbers that changed hands, and members to be forgotten.

#include <algorithm>
#include <utility>

#include "archive/GameArchive.h"
#include "archive/GuestRows.h"
#include "core/game/DallasId.h"
#include "platform/RuntimeError.h"
#include "platform/Sql.h"

std::vector<CutMember> GameArchive::CheckMembers() {
  std::vector<CutMember> cut;
  for (const std::int32_t number : known_.FindStrangers()) {
    cut.push_back({number, CutFromGames(number)});
  }
  known_.RaiseCounter();
  return cut;
}

int GameArchive::CutFromGames(std::int32_t number) {
  WriteScope scope(archive_);
  Sql& sql = archive_.Statements();
  const Value member = std::int64_t{number};
  const std::int64_t games =
      WholeNumber(sql, "SELECT count(DISTINCT GameID) FROM GamePlayers WHERE MemberID = $1", {member});
  // An earlier state may have had the member where the last one has not.
  const std::vector<StoredFile> files = FilesWhere(
      "GameFiles.State > 0 OR GameFiles.GameID IN (SELECT GameID FROM GamePlayers WHERE MemberID = $1)",
      {member});
  const Cut cut = [number](Player& player) {
    return player.MemberIndex == number && std::exchange(player.MemberIndex, 0) != 0;
  };
  for (const StoredFile& file : files) {
    CutFromFile(file, cut);
  }
  sql.Change("UPDATE GamePlayers SET MemberID = 0 WHERE MemberID = $1", {member});
  known_.Forget(number);
  scope.Commit();
  return static_cast<int>(games);
}

std::vector<std::string> GameArchive::ButtonsOf(std::int32_t number) {
  std::vector<std::string> buttons;
  archive_.Statements().Query(
      "SELECT DallasID FROM GamePlayers WHERE MemberID = $1 UNION "
      "SELECT DallasID FROM KnownMembers WHERE MemberID = $1",
      {std::int64_t{number}}, [&buttons](const SqlRow& row) {
        if (const std::string button = row.Text(0); !button.empty() && button != NoDallasId) {
          buttons.push_back(button);
        }
      });
  return buttons;
}

int GameArchive::Forget(std::int32_t number) {
  WriteScope scope(archive_);
  Sql& sql = archive_.Statements();
  const Value member = std::int64_t{number};
  const std::string none = NoDallasId;
  const std::vector<std::string> buttons = ButtonsOf(number);
  std::string condition =
      "GameFiles.State > 0 OR GameFiles.GameID IN (SELECT GameID FROM GamePlayers WHERE MemberID = $1";
  SqlValues values{member};
  for (const std::string& button : buttons) {
    values.emplace_back(button);
    condition.append(" OR (MemberID = 0 AND DallasID = $").append(std::to_string(values.size())).append(")");
  }
  const std::int64_t games =
      WholeNumber(sql, "SELECT count(DISTINCT GameID) FROM GamePlayers WHERE MemberID = $1", {member});
  const Cut cut = [&](Player& player) {
    const bool isMember = player.MemberIndex == number;
    const bool isGuest =
        player.MemberIndex == 0 && std::ranges::find(buttons, player.DallasID) != buttons.end();
    if (isMember || isGuest) {
      player.MemberIndex = 0;
      player.DallasID = none;
    }
    return isMember || isGuest;
  };
  for (const StoredFile& file : FilesWhere(condition + ")", values)) {
    CutFromFile(file, cut);
  }
  ForgetGuestNames(archive_, number, buttons);
  sql.Change("UPDATE GamePlayers SET MemberID = 0, DallasID = $2 WHERE MemberID = $1", {member, none});
  for (const std::string& button : buttons) {
    sql.Change("UPDATE GamePlayers SET DallasID = $2 WHERE MemberID = 0 AND DallasID = $1", {button, none});
  }
  known_.Forget(number);
  scope.Commit();
  return static_cast<int>(games);
}

void GameArchive::CutFromFile(const StoredFile& file, const Cut& cut) {
  Game game(strings_);
  GameState state{.Game = game};
  try {
    state.Mission = ReadGame(file.Name, game);
  } catch (const RuntimeError& error) {
    if (error.Number() != Fault::InvalidFileFormat) {
      throw;
    }
    return;  // nobody can read the number either
  }
  bool isIn = false;
  for (Player& player : game.Players) {
    isIn = cut(player) || isIn;
  }
  if (!isIn) {
    return;
  }
  Sql& sql = archive_.Statements();
  const PackedState packed = Pack(state);
  sql.Query("SELECT Played FROM Games WHERE GameID = $1", {file.GameId},
            [&state](const SqlRow& row) { state.Played = row.Text(0); });
  WriteFile(file, packed, state.Played);
  if (file.State == 0) {
    sql.Change("UPDATE Games SET InputsHash = $1 WHERE GameID = $2", {packed.Hash, file.GameId});
  }
}
