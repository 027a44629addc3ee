// The main window's commands on past games.

#include "app/PastChart.h"
#include "app/frmRx.h"
#include "archive/past/PastGames.h"
#include "core/gamefile/GameFile.h"
#include "members/MemberHits.h"
#include "ui/WaitCursor.h"

void frmRx::ShowPastGames() {
  std::optional<PastGames::Opened> past;
  {
    PastGames window(
        {.Archive = *archive_,
         .Time = services_.Time,
         .Boxes = services_.Boxes,
         .CommonDialog1 = services_.CommonDialog1,
         .Disk = services_.Disk,
         .Events = services_.Events,
         .Strings = services_.Strings,
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
      guests_.SetNames(past.Guests);
    }
    return isGame;
  });
}

void frmRx::ShowPastCharts(const PastGame& past) {
  GameCharts window({.Strings = services_.Strings,
                     .Boxes = services_.Boxes,
                     .CommonDialog1 = services_.CommonDialog1,
                     .Disk = services_.Disk});
  window.ShowGame(
      ChartOf(past, NickNamesOfSession(), *hidden_, PointsOfMission(session_.DbScenarios(), past.Mission)));
  window.exec();
}
