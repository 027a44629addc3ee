#include "members/Members.h"

#include <QDateTime>
#include <QFocusEvent>
#include <QKeyEvent>
#include <QLocale>
#include <QTimer>
#include <initializer_list>
#include <utility>

#include "core/data/FieldValue.h"
#include "core/data/Photo.h"
#include "core/game/Game.h"
#include "core/text/NumberForms.h"
#include "members/MemberListView.h"
#include "members/MemberQueries.h"
#include "platform/ErrorReport.h"
#include "platform/qt/QtClock.h"
#include "ui/Text.h"
#include "ui/WaitCursor.h"
#include "ui_Members.h"

namespace {

QString DateText(const std::string& stored) {
  QString text = QString::fromStdString(stored);
  const QDateTime date = QDateTime::fromString(text, QStringLiteral("yyyy-MM-dd HH:mm:ss"));
  if (!date.isValid()) {
    return text;
  }
  const QLocale locale = QLocale::system();
  return QString::fromStdString(ShortDateText(locale, date.date()) + " " +
                                ShortTimeText(locale, date.time()));
}

QString FigureText(const Value& value) {
  const bool isNull = std::holds_alternative<std::monostate>(value);
  return isNull ? QString() : QString::fromStdString(PlainDecimal(NumberOf(value)));
}

QString AccuracyText(double accuracy) {
  return accuracy == 0 ? QStringLiteral("N/A") : QString::fromStdString(FormatPercent(accuracy));
}

/// Gives a display room for `text`: what it shows later must not change the layout.
void ReserveRoom(QLabel& display, const QString& text) {
  display.setMinimumWidth(display.fontMetrics().horizontalAdvance(text));
}

void Show(QLineEdit& entry, const std::string& text) {
  entry.setText(QString::fromStdString(text));
  entry.setCursorPosition(0);
}

}  // namespace

Members::Members(Parts parts, QWidget* parent)
    : QDialog(parent),
      ui_(std::make_unique<Ui::Members>()),
      parts_(std::move(parts)),
      commands_(*this, parts_.Boxes) {
  ui_->setupUi(this);
  ui_->Dummy->hide();
  ui_->SearchText->installEventFilter(this);
  SetCaptions();
  ReserveRoomForFigures();
  BoundControls& controls = *this;
  data1_.emplace(parts_.DbMembers, controls);
  ConnectCommands();
  SetUpList();
}

Members::~Members() = default;

void Members::SetCaptions() {
  const StringTable& strings = parts_.Strings;
  ui_->HistoryButton->setText(Text(strings, OwnText::HistoryButton));
  ui_->HistoryButton->setVisible(parts_.ShowHistory != nullptr);
  ui_->SearchText->setPlaceholderText(Text(strings, OwnText::NameToSearchFor));
  ui_->MemberPhoto->setAccessibleName(Text(strings, OwnText::Photo));
  ui_->DOBPicker->SetCalendarName(Text(strings, OwnText::Calendar));
  const std::pair<QAbstractButton*, OwnText> arrows[] = {
      {ui_->DataFirst, OwnText::FirstMember},
      {ui_->DataPrevious, OwnText::PreviousMember},
      {ui_->DataNext, OwnText::NextMember},
      {ui_->DataLast, OwnText::LastMember},
  };
  for (const auto& [arrow, name] : arrows) {
    arrow->setAccessibleName(Text(strings, name));
    arrow->setToolTip(Text(strings, name));
  }
}

void Members::ReserveRoomForFigures() {
  ReserveRoom(*ui_->MemberIDDisplay, QStringLiteral("DDDDDDDDDDDDDDDD"));
  for (QLabel* display : {ui_->DateJoinedDisplay, ui_->LastPlayedDisplay}) {
    ReserveRoom(*display, DateText("2028-09-28 20:58:58") + QStringLiteral("  "));
  }
  for (QLabel* display : {ui_->TotalDamageDisplay, ui_->AverageDamageDisplay, ui_->TotalSoldieringDisplay,
                          ui_->AverageSoldieringDisplay}) {
    ReserveRoom(*display, QStringLiteral("-1234567.25"));
  }
  for (QLabel* display : {ui_->PrimaryAccuracyDisplay, ui_->SecondaryAccuracyDisplay}) {
    ReserveRoom(*display, QStringLiteral("100.00%"));
  }
}

void Members::ConnectCommands() {
  commands_.Connect(*this, {
                               {ui_->Search, &Members::SearchByCommand},
                               {ui_->ClearSearch, &Members::RunClearSearch},
                               {ui_->NewMember, &Members::AddMember},
                               {ui_->Delete, &Members::DeleteMember},
                               {ui_->ChangeID, &Members::ChangeMemberId},
                               {ui_->ChangePicture, &Members::ChangeMemberPicture},
                               {ui_->OK, &Members::SelectMember},
                               {ui_->HistoryButton, &Members::ShowGames},
                           });
  commands_.Connect(*data1_, {
                                 {ui_->DataFirst, &MemberCursor::MoveFirst},
                                 {ui_->DataPrevious, &MemberCursor::MovePrevious},
                                 {ui_->DataNext, &MemberCursor::MoveNext},
                                 {ui_->DataLast, &MemberCursor::MoveLast},
                             });
  commands_.EscapePresses(*ui_->OK);
}

void Members::RunInFocusChange(const std::function<void()>& command) {
  try {
    command();
  } catch (const RuntimeError& error) {
    QTimer::singleShot(0, this, [this, number = error.Number(), text = std::string(error.what())] {
      ShowErrorReport(parts_.Boxes, number, text);
    });
  }
}

void Members::showEvent(QShowEvent* event) {
  QDialog::showEvent(event);
  if (!event->spontaneous()) {
    commands_.Run([this] { Activate(); });
  }
}

void Members::Activate() {
  RunClearSearch();
  if (ContactToShow != 0) {
    data1_->WalkTo(ContactToShow);
    // No entry gets the focus: a stray key would change the name, and leaving the search box would go back to
    // the first member.
    setFocus();
  } else {
    ui_->SearchText->setFocus();
  }
}

// From the window itself the Tab key goes to the member in view, past the search box.
bool Members::focusNextPrevChild(bool next) {
  if (next && focusWidget() == this && ui_->FirstNameEntry->isEnabled()) {
    ui_->FirstNameEntry->setFocus(Qt::TabFocusReason);
    return true;
  }
  return QDialog::focusNextPrevChild(next);
}

// Called by the close box.
void Members::reject() {
  commands_.Run([this] { RunClearSearch(); });
  QDialog::reject();
}

// Does not count a click on Search as leaving, since it runs the search itself: a malformed query is then
// reported once, not twice.
bool Members::IsLeaving(Qt::FocusReason reason) const {
  const bool toSearch = focusWidget() == ui_->Search && reason != Qt::TabFocusReason;
  return !toSearch && reason != Qt::ActiveWindowFocusReason && reason != Qt::PopupFocusReason;
}

bool Members::eventFilter(QObject* watched, QEvent* event) {
  if (watched == ui_->SearchText && event->type() == QEvent::KeyPress) {
    const int key = static_cast<QKeyEvent*>(event)->key();
    if (key == Qt::Key_Return || key == Qt::Key_Enter) {
      commands_.Run([this] { SearchByCommand(); });  // instead of OK, which would choose the member in view
      return true;
    }
    if (key == Qt::Key_Down) {
      EnterList();
      return true;
    }
  }
  if (watched == ui_->SearchText && event->type() == QEvent::FocusOut && isVisible() &&
      IsLeaving(static_cast<QFocusEvent*>(event)->reason())) {
    if (listTimer_->isActive()) {
      ListHits();
    }
    RunInFocusChange([this] { RunSearch(); });
  }
  return QDialog::eventFilter(watched, event);
}

void Members::ShowRow(Recordset& rows) {
  const MemberDetails details = ReadDetails(rows);
  Show(*ui_->FirstNameEntry, details.FirstName);
  Show(*ui_->LastNameEntry, details.LastName);
  Show(*ui_->NickNameEntry, details.NickName);
  Show(*ui_->ClanEntry, details.Clan);
  ui_->DOBPicker->SetStored(details.Birthdate);
  Show(*ui_->AddressEntry, details.Address);
  Show(*ui_->CityEntry, details.City);
  Show(*ui_->PostCodeEntry, details.PostalCode);
  Show(*ui_->EmailEntry, details.EmailName);
  Show(*ui_->PhoneNumberEntry, details.PhoneNumber);
  const std::pair<QLabel*, const char*> figures[] = {
      {ui_->TotalGamesPlayedDisplay, "TotalGamesPlayed"},   {ui_->TotalDamageDisplay, "TotalDamage"},
      {ui_->AverageDamageDisplay, "AverageDamage"},         {ui_->TotalSoldieringDisplay, "TotalSoldiering"},
      {ui_->AverageSoldieringDisplay, "AverageSoldiering"},
  };
  for (const auto& [display, column] : figures) {
    display->setText(FigureText(rows.Fields(column)));
  }
  ui_->MemberIDDisplay->setText(QString::fromStdString(TextOf(rows.Fields("DallasID"))));
  ui_->Dummy->setText(QString::fromStdString(TextOf(rows.Fields("ContactID"))));
  ui_->DateJoinedDisplay->setText(DateText(TextOf(rows.Fields("DateJoined"))));
  ui_->LastPlayedDisplay->setText(DateText(TextOf(rows.Fields("LastPlayedDate"))));
  SetRowEnabled(true);
}

void Members::ShowNoRow() {
  for (QLineEdit* entry :
       {ui_->FirstNameEntry, ui_->LastNameEntry, ui_->NickNameEntry, ui_->ClanEntry, ui_->AddressEntry,
        ui_->CityEntry, ui_->PostCodeEntry, ui_->EmailEntry, ui_->PhoneNumberEntry}) {
    entry->clear();
  }
  ui_->DOBPicker->SetStored({});
  for (QLabel* display : {ui_->MemberIDDisplay, ui_->DateJoinedDisplay, ui_->LastPlayedDisplay,
                          ui_->TotalGamesPlayedDisplay, ui_->TotalDamageDisplay, ui_->AverageDamageDisplay,
                          ui_->TotalSoldieringDisplay, ui_->AverageSoldieringDisplay, ui_->Dummy}) {
    display->clear();
  }
  SetRowEnabled(false);
}

void Members::SetRowEnabled(bool enabled) {
  for (QWidget* control :
       std::initializer_list<QWidget*>{ui_->NameFrame, ui_->PersonalDetails, ui_->ContactDetails,
                                       ui_->ChangePicture, ui_->Delete, ui_->HistoryButton}) {
    control->setEnabled(enabled);
  }
  ui_->ChangeID->setEnabled(enabled && parts_.ButtonSwipe != nullptr);
}

MemberDetails Members::Entered() const {
  const auto text = [](const QLineEdit* entry) { return entry->text().toStdString(); };
  return {text(ui_->FirstNameEntry),  text(ui_->LastNameEntry), text(ui_->NickNameEntry),
          text(ui_->ClanEntry),       ui_->DOBPicker->Stored(), text(ui_->AddressEntry),
          text(ui_->CityEntry),       text(ui_->PostCodeEntry), text(ui_->EmailEntry),
          text(ui_->PhoneNumberEntry)};
}

void Members::RowChanged() {
  ShowPlace();
  RefreshList();
  ShowMemberInList();
  ShowMemberExtras();
}

void Members::ShowPlace() {
  const QLocale locale = QLocale::system();
  ui_->DataPlace->setText(locale.toString(data1_->Rows().AbsolutePosition() + 1) + QStringLiteral(" / ") +
                          locale.toString(data1_->Rows().RecordCount()));
}

void Members::ShowMemberExtras() {
  Recordset& rows = data1_->Rows();
  if (rows.Eof() || rows.Bof()) {
    return;
  }
  if (NumberOf(rows.Fields("PhotographLength")) != 0) {
    ReadPhoto();
  } else {
    ui_->MemberPhoto->Clear();
  }
  ui_->PrimaryAccuracyDisplay->setText(AccuracyText(NumberOf(rows.Fields("AveragePrimAccuracy"))));
  ui_->SecondaryAccuracyDisplay->setText(AccuracyText(NumberOf(rows.Fields("AverageSecAccuracy"))));
}

void Members::ReadPhoto() {
  const WaitCursor cursor;
  ui_->MemberPhoto->Load(StoredPhoto(data1_->Rows(), "Photograph", "PhotographLength"));
}

void Members::PreviewPhoto(const std::string& file) {
  try {
    ui_->MemberPhoto->Load(parts_.Disk.Read(file));
  } catch (const RuntimeError&) {
    ui_->MemberPhoto->Clear();  // storing the photo will report why
  }
}

void Members::RunSearch() {
  ui_->MemberPhoto->Clear();
  data1_->Refresh(SearchQuery(ui_->SearchText->text().toStdString()));
}

void Members::RunClearSearch() {
  data1_->Refresh(AllMembers);
  ui_->SearchText->clear();
  ListHits();
}

void Members::AddMember() {
  data1_->AddMember(parts_.Time.Now());
  ListHits();
  ui_->FirstNameEntry->setFocus();
  ui_->FirstNameEntry->selectAll();
}

void Members::DeleteMember() {
  const BoxAnswer answer =
      parts_.Boxes.Show("This will delete the Member. Are you Sure?", parts_.Strings.Text(124),
                        BoxIcon::Question, BoxButtons::OkCancel);
  if (answer == BoxAnswer::Ok) {
    data1_->Delete();
    ListHits();
  }
  ShowMemberExtras();
}

void Members::ChangeMemberId() {
  const std::string dallasId = parts_.ButtonSwipe();
  if (dallasId != NoDallasId) {
    data1_->SetField("DallasID", dallasId);
    ui_->MemberIDDisplay->setText(QString::fromStdString(dallasId));
  }
}

void Members::ChangeMemberPicture() {
  data1_->WriteBack();
  const std::optional<std::string> file =
      parts_.CommonDialog1.ShowOpen({.Filter = "Photo Files(*.bmp,*.jpg,*.gif)|*.bmp;*.jpg;*.gif"});
  if (!file) {
    ShowMemberExtras();
    return;
  }
  Recordset& rows = data1_->Rows();
  try {
    PreviewPhoto(*file);
    rows.Edit();
    StorePhoto(*file, rows, "Photograph", "PhotographLength", parts_.Disk, parts_.Boxes);
    rows.Update();
    ui_->MemberHits->ForgetPhoto(ui_->Dummy->text().toLongLong());
  } catch (const RuntimeError&) {
    if (rows.EditMode() != EditMode::None) {
      rows.CancelUpdate();
    }
    ShowMemberExtras();
    throw;
  }
  ShowMemberExtras();
}

void Members::ShowGames() {
  data1_->WriteBack();
  parts_.ShowHistory(ui_->Dummy->text().toInt(), *this);
}

void Members::SelectMember() {
  data1_->Refresh(
      NameQuery(ui_->FirstNameEntry->text().toStdString(), ui_->LastNameEntry->text().toStdString()));
  selectedContact_ = TextOf(data1_->Rows().Fields("ContactID"));
  accept();
}
