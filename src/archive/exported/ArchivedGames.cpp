#include "archive/exported/ArchivedGames.h"

#include <algorithm>
#include <string_view>
#include <unordered_set>
#include <utility>

#include "core/game/PublicName.h"
#include "core/game/Standings.h"
#include "platform/Sql.h"

namespace {

/// A text of the row, without a copy.
std::string_view TextIn(const SqlRow& row, std::size_t column) {
  const auto* text = std::get_if<std::string>(&row[column]);
  return text != nullptr ? std::string_view(*text) : std::string_view();
}

/// The players of so many games.
std::string FiguresQuery(bool hasGuestNames) {
  std::string query =
      "SELECT g.GameID, g.Played, g.DateText, g.Mission, p.Place, p.PlayerIndex, p.MemberID, p.DallasID, "
      "p.Soldiering, p.Accuracy, p.DamageDealt, p.Shots, p.Wia, p.Kia, p.AmmoAdds, p.Committed, "
      "p.DamageTaken, ";
  query.append(hasGuestNames ? "p.GuestName" : "NULL")
      .append(
          " FROM Games g CROSS JOIN GamePlayers p WHERE p.GameID = g.GameID AND g.Deleted IS NULL "
          "AND g.GameID IN (");
  for (std::size_t number = 1; number <= ExportSource::FiguresAtOnce; ++number) {
    query.append(number == 1 ? "$" : ", $").append(std::to_string(number));
  }
  return query.append(") ORDER BY g.Played, g.GameID, p.Place");
}

PlayerFigures FiguresIn(const SqlRow& row) {
  return {.GameId = row.Integer(0),
          .Received = TextIn(row, 1),
          .GameDate = TextIn(row, 2),
          .Mission = TextIn(row, 3),
          .Place = static_cast<int>(row.Integer(4)),
          .Index = static_cast<int>(row.Integer(5)),
          .Member = row.Integer(6),
          .Button = TextIn(row, 7),
          .Soldiering = row.Integer(8),
          .Accuracy = row.IsNull(9) ? std::nullopt : std::optional(static_cast<float>(row.Real(9))),
          .Damage = row.Integer(10),
          .Shots = row.Integer(11),
          .Heals = row.Integer(12),
          .Deaths = row.Integer(13),
          .AmmoAdds = row.Integer(14),
          .Committed = row.Integer(15) != 0,
          .DamageTaken = row.Integer(16)};
}

}  // namespace

ArchivedGames::ArchivedGames(ArchiveAccess& archives, Session& session, const StringTable& strings,
                             const HiddenNames* hidden)
    : archives_(archives), session_(session), hidden_(hidden) {
  const Game empty(strings);
  for (int index = 1; index <= PlayerCount; ++index) {
    guns_[static_cast<std::size_t>(index - 1)] = GunName(empty, index);
  }
}

std::vector<std::int64_t> ArchivedGames::InOrder(const std::vector<std::int64_t>& games) {
  if (games.empty()) {
    return {};
  }
  const std::unordered_set<std::int64_t> wanted(games.begin(), games.end());
  std::vector<std::int64_t> all = archives_.Queries().Games({});
  std::erase_if(all, [&wanted](std::int64_t game) { return !wanted.contains(game); });
  std::ranges::reverse(all);
  return all;
}

std::vector<std::int64_t> ArchivedGames::Of(const std::string& firstDay, const std::string& lastDay) {
  // Every time of that day is below it, and the next day is above.
  std::vector<std::int64_t> games = archives_.Queries().Games({.From = firstDay, .Before = lastDay + " 24"});
  std::ranges::reverse(games);
  return games;
}

void ArchivedGames::Read(std::int64_t gameId, const std::function<void(const ExportedGame&)>& take) {
  const PastGame past = archives_.Read(gameId);
  const ReadScope scope(session_.DbMembers());
  std::vector<Standing> standings = Standings(past.Game, archives_.Names(), past.NamesOfGuests());
  if (hidden_ != nullptr) {
    LeaveOutHidden(standings, past.Game, *hidden_, archives_.Names(), past.NamesOfGuests());
  }
  take({.Game = past.Game,
        .Received = past.Played,
        .Mission = past.Mission,
        .Standings = std::move(standings),
        .FullNameOf = [this](std::int32_t contactId) { return FullNameOf(contactId); }});
}

void ArchivedGames::ReadFigures(const std::vector<std::int64_t>& games, bool fullNames,
                                const std::function<void(const PlayerFigures&)>& take) {
  static const std::string queries[] = {FiguresQuery(false), FiguresQuery(true)};
  if (games.empty()) {
    return;
  }
  SqlValues numbers;
  for (std::size_t place = 0; place < FiguresAtOnce; ++place) {
    numbers.emplace_back(games[std::min(place, games.size() - 1)]);
  }
  const ReadScope scope(session_.DbMembers());
  const std::string& query = queries[archives_.HasNamesOfGuests() ? 1 : 0];
  archives_.Statements().Query(query, numbers, [&](const SqlRow& row) {
    PlayerFigures figures = FiguresIn(row);
    constexpr std::size_t guestColumn = 17;
    const std::string name = NameShown(figures.Member, TextIn(row, guestColumn));
    figures.Name = name.empty() ? GunAt(figures.Index) : name;
    if (fullNames) {
      figures.Person = KnownFullName(figures.Member);
    }
    take(figures);
  });
}

FullName ArchivedGames::FullNameOf(std::int32_t contactId) {
  const std::optional<Member> member = session_.Members().FindMember(contactId);
  return member ? FullName{member->FirstName, member->LastName} : FullName();
}

const FullName& ArchivedGames::KnownFullName(std::int64_t contactId) {
  const auto [found, isNew] = fullNames_.try_emplace(contactId);
  if (isNew && contactId != 0) {
    found->second = FullNameOf(static_cast<std::int32_t>(contactId));
  }
  return found->second;
}

const std::string& ArchivedGames::GunAt(int index) const {
  if (index < 1 || index > PlayerCount) {
    throw RuntimeError(Fault::SubscriptOutOfRange);
  }
  return guns_[static_cast<std::size_t>(index - 1)];
}

std::string ArchivedGames::NameShown(std::int64_t contactId, std::string_view guest) {
  const std::string& nickName = NickNameOf(contactId);
  if (hidden_ == nullptr) {
    return nickName.empty() && !guest.empty() ? CleanName(guest) : nickName;
  }
  return hidden_->NameShown({.Member = static_cast<std::int32_t>(contactId),
                             .NickName = nickName,
                             .GuestName = guest.empty() ? std::string() : CleanName(guest)});
}

const std::string& ArchivedGames::NickNameOf(std::int64_t contactId) {
  const auto [found, isNew] = names_.try_emplace(contactId);
  if (isNew && contactId != 0) {
    found->second = CleanName(session_.Members().NickNameOf(static_cast<std::int32_t>(contactId)));
  }
  return found->second;
}
