// The main window's commands on past games.

#include <algorithm>

#include "app/PastChart.h"
#include "app/frmRx.h"
#include "archive/past/PastGames.h"
#include "core/gamefile/GameFile.h"
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
         .Export = [this](const std::vector<std::int64_t>& games) { ShowExport(games); },
         .Import = [this] { ImportGameFiles(); }},
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
  window.ShowGame(ChartOf(past, NickNamesOfSession(), PointsOfMission(session_.DbScenarios(), past.Mission)));
  window.exec();
}
