// The main window's commands on the board for the audience.

#include <QTimer>

#include "app/frmRx.h"
#include "audience/AudienceSettings.h"
#include "audience/GuestNameEntry.h"
#include "core/text/Filled.h"
#include "ui/Text.h"
#include "ui_frmRx.h"

void frmRx::SetUpAudience() {
  hidden_.emplace(services_.Disk, userDataFolder_ + "/hidden-names.txt");
  audience_.emplace(AudienceBoard::Parts{
      .Session = session_,
      .Guests = guests_,
      .Strings = services_.Strings,
      .Ini = *ini_,
      .StateIni = *state_,
      .Awake = services_.Awake,
      .Disk = services_.Disk,
      .Operator = *this,
      .NameShown = [this](const NameHolder& holder) { return results_->NameOnBoard(holder); }});
  audience_->setParent(this);
  connect(&*audience_, &AudienceBoard::Switched, this, &frmRx::FollowAudienceBoard);
  // Not before this window is shown.
  QTimer::singleShot(0, &*audience_, &AudienceBoard::Reopen);
}

void frmRx::FollowAudienceBoard() {
  const bool isOn = audience_->IsOn();
  ui_->mnuAudienceBoard->setChecked(isOn);
  auto* copy = ui_->GameBar->findChild<QWidget*>(QStringLiteral("AudienceCopy"));
  if (copy == nullptr) {
    if (!isOn) {
      return;
    }
    copy = new AudienceCopy(audience_->Stage(), ui_->GameBar);
    copy->setAccessibleName(Text(services_.Strings, OwnText::AudienceCopyTip));
    ui_->GameBar->SetEnd(copy);
  }
  const std::string awaited = audience_->AwaitedScreen();
  copy->setToolTip(awaited.empty() ? Text(services_.Strings, OwnText::AudienceCopyTip)
                                   : QString::fromStdString(
                                         Filled(services_.Strings.Text(OwnText::AudienceAwaits), {awaited})));
  ui_->GameBar->SetEndWanted(isOn);
}

void frmRx::ToggleAudienceBoard() {
  audience_->Toggle();
  ui_->mnuAudienceBoard->setChecked(audience_->IsOn());
}

void frmRx::ShowAudienceResults() {
  audience_->ShowResults();
}

void frmRx::ShowAudienceVenue() {
  audience_->State().ShowIdle();
}

void frmRx::BlankAudienceBoard() {
  audience_->State().ShowBlank();
}

void frmRx::EnterGuestNames() {
  GuestNameEntry window(session_.Game(), guests_, services_.Strings, this);
  if (window.exec() == QDialog::Accepted) {
    audience_->SetGuests(window.Names());
    results_->ShowOtherNames();
    charts_->ShowOtherNames();
  }
}

void frmRx::ShowAudienceSettings() {
  AudienceSettings window(audience_->Setup(),
                          {.Boxes = services_.Boxes,
                           .Dialogs = services_.CommonDialog1,
                           .Disk = services_.Disk,
                           .Strings = services_.Strings},
                          this);
  if (window.exec() == QDialog::Accepted) {
    audience_->SetSetup(window.Setup());
  }
}
