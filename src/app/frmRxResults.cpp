// The main window's commands on the results page and on hidden names.

#include <QTimer>

#include "app/MonthRanks.h"
#include "app/frmRx.h"
#include "core/text/Filled.h"
#include "platform/RuntimeError.h"
#include "ui_frmRx.h"
#include "web/ResultsPage.h"
#include "web/ResultsPoster.h"

void frmRx::SetUpResults() {
  results_.emplace(ResultsHost::Parts{
      .Session = session_,
      .Guests = guests_,
      .Hidden = *hidden_,
      .Strings = services_.Strings,
      .Ini = *ini_,
      .Time = services_.Time,
      .Elapsed = services_.Elapsed,
      .Addresses = services_.Addresses,
      .MakeProgram = services_.MakePipedProgram,
      .Path = services_.ResultsProgram,
      .Pulling = [this] { return downloading_; },
      .AwaitsBoard = [this] { return audience_->IsOn() && !audience_->State().ShowsGameOfBoard(); },
      .Ranks =
          [this] {
            return MonthRanks({.Archive = archive_->Statements(),
                               .Now = services_.Time.Now(),
                               .DbMembers = session_.DbMembers(),
                               .NickNameOf = NickNamesOfSession()});
          },
      .Kept = KeptGames()});
  results_->setParent(this);
  hidden_->OnChange = [this] { ShowOtherNames(); };
  connect(&*audience_, &AudienceBoard::Changed, &*results_, &ResultsHost::Follow);
  connect(&*audience_, &AudienceBoard::Switched, &*results_, &ResultsHost::Follow);
  connect(&*results_, &ResultsHost::Changed, this,
          [this] { audience_->State().SetAddress(results_->Url()); });
  connect(&*results_, &ResultsHost::NamesChanged, &*audience_, &AudienceBoard::ShowOtherNames);
  // Not before this window is shown.
  QTimer::singleShot(0, &*results_, &ResultsHost::Begin);
}

ResultsHost::KeptEvening frmRx::KeptGames() {
  return {.Games = [this](const std::string& from) { return archive_->Queries().Games({.From = from}); },
          .Read =
              [this](std::int64_t number, const std::function<void(const ResultsHost::KeptGame&)>& take) {
                const PastGame past = archive_->Read(number);
                take({.Game = past.Game, .Played = past.Played, .OfGuests = past.NamesOfGuests()});
              }};
}

NickNames frmRx::NickNamesOfSession() {
  return [this](std::int32_t contactId) { return session_.Members().NickNameOf(contactId); };
}

void frmRx::ShowOtherNames() {
  audience_->ShowOtherNames();
  results_->ShowOtherNames();
  charts_->ShowOtherNames();
}

void frmRx::ShowResultsPage() {
  ResultsPage({.Host = *results_,
               .Hidden = *hidden_,
               .Addresses = services_.Addresses,
               .Boxes = services_.Boxes,
               .Strings = services_.Strings,
               .NickNameOf = NickNamesOfSession(),
               .PrintPoster = [this](const std::string& url) { PrintResultsPoster(url); }},
              this)
      .exec();
}

void frmRx::PrintResultsPoster(const std::string& url) {
  const std::string path = userDataFolder_ + "/results-poster.pdf";
  services_.Disk.Replace(path, ResultsPoster(services_.Strings, audience_->Setup().Venue, url));
  try {
    services_.OtherPrograms.Start({"xdg-open", path});
  } catch (const RuntimeError&) {
    services_.Boxes.Show(Filled(services_.Strings.Text(OwnText::PosterUnopened), {path}), DefaultBoxTitle,
                         BoxIcon::Information);
  }
}

void frmRx::HideSelectedPlayer() {
  const auto tell = [this](const std::string& text, BoxIcon icon) {
    services_.Boxes.Show(text, DefaultBoxTitle, icon);
  };
  if (!SelectPlayer()) {
    tell(services_.Strings.Text(OwnText::HideSelectFirst), BoxIcon::Information);
    return;
  }
  const NameHolder holder = HolderOf(session_.Game(), selectedPlayer_, NickNamesOfSession(),
                                     [this](int index) { return guests_.NameOf(index); });
  const std::string gun = GunName(session_.Game(), selectedPlayer_);
  const std::string& name = holder.NickName.empty() ? holder.GuestName : holder.NickName;
  const bool isHidden = hidden_->Hide(holder);
  tell(Filled(services_.Strings.Text(isHidden ? OwnText::HideDone : OwnText::HideNothing),
              {name.empty() ? gun : name}),
       BoxIcon::Information);
}
