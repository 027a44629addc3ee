// The main window's commands on game files and exports, and files dropped on it.

#include <QApplication>
#include <QDropEvent>
#include <QFileInfo>
#include <QMimeData>
#include <QTimer>
#include <QUrl>
#include <utility>

#include "app/StateKeys.h"
#include "app/frmRx.h"
#include "archive/exported/ArchivedGames.h"
#include "archive/import/ImportGames.h"
#include "core/gamefile/SuggestedName.h"
#include "core/text/Filled.h"
#include "exports/ExportGames.h"
#include "ui/WaitCursor.h"
#include "ui_frmRx.h"

namespace {

/// The path of the only file in `data`; empty if there is none or more than one.
QString OnlyFile(const QMimeData& data) {
  const QList<QUrl> urls = data.urls();
  return urls.size() == 1 && QFileInfo(urls.front().toLocalFile()).isFile() ? urls.front().toLocalFile()
                                                                            : QString();
}

}  // namespace

void frmRx::LoadGame() {
  if (gameFile_.AskForGame()) {
    ReadGame();
  }
}

void frmRx::ReadGame() {
  const WaitCursor cursor;
  session_.LoadGame([this](Game& game, const Session::MissionChoice& chooseMission) {
    std::string mission;
    const bool isGame = gameFile_.LoadGame(game, [&](const std::string& name) {
      mission = name;
      chooseMission(name);
    });
    if (isGame) {
      keeping_->Load(game, mission, gameFile_.TimeOfChange());
    }
    return isGame;
  });
}

void frmRx::SaveGame() {
  desk_->TellFileOfCancel({});
  const bool suggests = session_.Game().DataPresent && (fromArchive_ || !desk_->Progress().HasFile());
  const std::string before = gameFile_.SaveFolder();
  session_.SaveGame([&](const Game& game, const std::string& missionName) {
    return gameFile_.SaveGame(
        game, missionName,
        suggests ? SuggestedGameName(desk_->Progress().Received(), missionName) : std::string());
  });
  desk_->TellFileOfCancel(gameFile_.SavedOnCancel());
  if (gameFile_.SaveFolder() != before) {
    state_->WriteIni(State::Games, State::SaveFolder, gameFile_.SaveFolder());
  }
}

void frmRx::ExportGame() {
  ShowExport({});
}

void frmRx::ShowExport(const std::vector<std::int64_t>& chosen) {
  const auto nickNameOf = [this](std::int32_t contactId) { return session_.Members().NickNameOf(contactId); };
  const auto fullNameOf = [this](std::int32_t contactId) {
    const std::optional<Member> member = session_.Members().FindMember(contactId);
    return member ? FullName{member->FirstName, member->LastName} : FullName();
  };
  const std::string received = desk_->Progress().Received();
  const auto game = [&](const std::function<void(const ExportedGame&)>& take) {
    const ReadScope scope(session_.DbMembers());
    const GuestNames guestNameOf = [this](int index) { return guests_.NameOf(index); };
    std::vector<Standing> standings = Standings(session_.Game(), nickNameOf, guestNameOf);
    LeaveOutHidden(standings, session_.Game(), *hidden_, nickNameOf, guestNameOf);
    take({.Game = session_.Game(),
          .Received = received,
          .Mission = session_.Missions().Text(),
          .Standings = std::move(standings),
          .FullNameOf = fullNameOf});
  };
  ArchivedGames past(*archive_, session_, services_.Strings, &*hidden_);
  ExportGames({.Game = session_.Game().DataPresent ? ExportGames::ThisGame(game) : nullptr,
               .SuggestedName = SuggestedFileName(received, session_.Missions().Text(), {}),
               .Past = past,
               .Chosen = past.InOrder(chosen),
               .CommonDialog1 = services_.CommonDialog1,
               .Disk = services_.Disk,
               .Boxes = services_.Boxes,
               .Events = services_.Events,
               .Time = services_.Time,
               .Strings = services_.Strings},
              this)
      .exec();
}

void frmRx::ImportGameFiles() {
  ImportGames({.Archives = *archive_,
               .Members = session_.DbMembers(),
               .Disk = services_.Disk,
               .CommonDialog1 = services_.CommonDialog1,
               .Boxes = services_.Boxes,
               .Events = services_.Events,
               .Elapsed = services_.Elapsed,
               .Time = services_.Time,
               .Strings = services_.Strings,
               .Factors = session_.Factors(),
               .UserDataFolder = userDataFolder_},
              this)
      .exec();
}

bool frmRx::IsBusy() const {
  return commands_.Running() || QApplication::activeModalWidget() != nullptr ||
         QApplication::activePopupWidget() != nullptr;
}

void frmRx::dragEnterEvent(QDragEnterEvent* event) {
  if (!IsBusy() && !OnlyFile(*event->mimeData()).isEmpty()) {
    event->acceptProposedAction();
  }
}

void frmRx::dropEvent(QDropEvent* event) {
  const QString path = OnlyFile(*event->mimeData());
  if (IsBusy() || path.isEmpty()) {
    event->ignore();
    return;
  }
  event->acceptProposedAction();
  // The program that it comes from waits for the end of this event, not for the operator's answer.
  QTimer::singleShot(0, this, [this, path] {
    if (isVisible() && !IsBusy()) {  // it may have been closed since
      commands_.Run([&] { LoadFromOutside(path.toStdString(), desk_->Progress().Unsaved()); });
      desk_->Show();
      desk_->FocusBoard();
    }
  });
}

void frmRx::LoadFromOutside(const std::string& path, bool losesGame) {
  if (losesGame) {
    const std::string question =
        Filled(services_.Strings.Text(OwnText::DropQuestion), {path.substr(path.find_last_of('/') + 1)});
    if (services_.Boxes.Show(question, DefaultBoxTitle, BoxIcon::Question, BoxButtons::OkCancel) !=
        BoxAnswer::Ok) {
      return;
    }
  }
  gameFile_.Choose(path);
  ReadGame();
}
