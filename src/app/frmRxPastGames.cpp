// The main window's commands on past games.

#include <algorithm>

#include "app/PastChart.h"
#include "app/frmRx.h"
#include "archive/past/PastGames.h"
#include "core/gamefile/GameFile.h"
#include "core/gamefile/SuggestedName.h"
#include "exports/ExportGames.h"
#include "members/MemberHits.h"
#include "ui/WaitCursor.h"

namespace {

std::vector<std::int32_t> MembersCalled(Database& dbMembers, const std::string& text) {
  constexpr int most = 100;  // more would be no search
  MemberHits hits(dbMembers);
  hits.Search(text);
  std::vector<std::int32_t> members;
  for (int position = 0; position < std::min(hits.Count(), most); ++position) {
    if (const std::optional<MemberHit> hit = hits.At(position)) {
      members.push_back(static_cast<std::int32_t>(hit->ContactId));
    }
  }
  return members;
}

}  // namespace

void frmRx::ShowPastGames() {
  std::optional<PastGames::Opened> past;
  {
    PastGames window(
        {.Archive = *archive_,
         .Time = services_.Time,
         .Boxes = services_.Boxes,
         .CommonDialog1 = services_.CommonDialog1,
         .Disk = services_.Disk,
         .Strings = services_.Strings,
         .NameOf = [this](std::int32_t contactId) { return BoardNameOf(contactId); },
         .MembersCalled =
             [this](const std::string& text) { return MembersCalled(session_.DbMembers(), text); },
         .BoardIsUnsaved = [this] { return desk_->Progress().Unsaved(); },
         .Busy = [this] { return RunningBesidesThis(); },
         .ShowCharts = [this](const PastGame& game) { ShowPastCharts(game); },
         .Export = [this](const std::vector<std::int64_t>& games) { ExportPastGames(games); }},
        this);
    window.exec();
    past = window.Chosen();
  }
  if (past) {
    OpenPastGame(*past);
  }
}

std::string frmRx::BoardNameOf(std::int32_t contactId) {
  const std::optional<Member> member = session_.Members().FindMember(contactId);
  return member ? member->GetPlayerName(true) : std::string();
}

void frmRx::OpenPastGame(const PastGames::Opened& past) {
  const WaitCursor cursor;
  gameFile_.Choose({});  // Cancel in Save Game must not write over the file used last
  session_.LoadGame([&](Game& game, const Session::MissionChoice& chooseMission) {
    std::string mission;
    const bool isGame = ReadGameFile(past.Bytes, game, [&](const std::string& name) {
      mission = name;
      chooseMission(name);
    });
    if (isGame) {
      fromArchive_ = true;
      keeping_->Open(past.GameId, past.State, game, mission);
    }
    return isGame;
  });
}

void frmRx::ShowPastCharts(const PastGame& past) {
  GameCharts window({.Strings = services_.Strings,
                     .Boxes = services_.Boxes,
                     .CommonDialog1 = services_.CommonDialog1,
                     .Disk = services_.Disk});
  window.ShowGame(ChartOf(
      past, [this](std::int32_t contactId) { return BoardNameOf(contactId); },
      PointsOfMission(session_.DbScenarios(), past.Mission)));
  window.exec();
}

void frmRx::ExportPastGames(const std::vector<std::int64_t>& games) {
  const auto fullNameOf = [this](std::int32_t contactId) {
    const std::optional<Member> member = session_.Members().FindMember(contactId);
    return member ? FullName{member->FirstName, member->LastName} : FullName();
  };
  const auto each = [&](const std::function<void(const ExportedGame&)>& take) {
    for (const std::int64_t game : games) {
      const PastGame past = archive_->Read(game);
      take({.Game = past.Game,
            .Received = past.Played,
            .Mission = past.Mission,
            .Standings = Standings(past.Game, archive_->Names()),
            .FullNameOf = fullNameOf});
    }
  };
  std::string name;
  if (const auto first = games.empty() ? std::nullopt : archive_->Queries().Game(games.front())) {
    name = SuggestedFileName(first->Played, games.size() == 1 ? first->Mission : std::string(), {});
  }
  ExportGames({.Games = each,
               .HasGames = !games.empty(),
               .SuggestedName = name,
               .CommonDialog1 = services_.CommonDialog1,
               .Disk = services_.Disk,
               .Boxes = services_.Boxes,
               .Strings = services_.Strings},
              this)
      .exec();
}
