#include "exports/ExportGames.h"

#include <QLocale>
#include <QScopeGuard>
#include <filesystem>
#include <initializer_list>
#include <utility>

#include "core/text/Filled.h"
#include "ui/Captions.h"
#include "ui/RunProgress.h"
#include "ui/Text.h"
#include "ui/WaitCursor.h"
#include "ui_ExportGames.h"

namespace {

constexpr std::pair<CsvSeparator, OwnText> Separators[] = {
    {CsvSeparator::Comma, OwnText::GameExportComma},
    {CsvSeparator::Semicolon, OwnText::GameExportSemicolon},
    {CsvSeparator::Tab, OwnText::GameExportTab}};

std::string FileNameIn(const std::string& path) {
  return std::filesystem::path(path).filename().string();
}

constexpr int DayLength = 10;  // "YYYY-MM-DD"

QDate DayOf(const std::string& time) {
  return QDate::fromString(QString::fromStdString(time).left(DayLength), Qt::ISODate);
}

std::string DayIn(const QDateEdit& entry) {
  return entry.date().toString(Qt::ISODate).toStdString();
}

/// The form of a short date of this computer, with all four digits of the year.
QString DayFormat() {
  QString format = QLocale().dateFormat(QLocale::ShortFormat);
  if (!format.contains(QStringLiteral("yyyy"))) {
    format.replace(QStringLiteral("yy"), QStringLiteral("yyyy"));
  }
  return format;
}

}  // namespace

ExportGames::ExportGames(const Parts& parts, QWidget* parent)
    : QDialog(parent),
      parts_(parts),
      ui_(std::make_unique<Ui::ExportGames>()),
      commands_(*this, parts.Boxes) {
  ui_->setupUi(this);
  const std::pair<QWidget*, OwnText> captions[] = {{this, OwnText::GameExportTitle},
                                                   {ui_->WhichFrame, OwnText::GameExportWhich},
                                                   {ui_->WhichThis, OwnText::GameExportThis},
                                                   {ui_->WhichPeriod, OwnText::GameExportPeriod},
                                                   {ui_->FromLabel, OwnText::GameExportFrom},
                                                   {ui_->ToLabel, OwnText::GameExportTo},
                                                   {ui_->FormatFrame, OwnText::GameExportFormatCaption},
                                                   {ui_->FormatPlayers, OwnText::GameExportPlayers},
                                                   {ui_->FormatFigures, OwnText::GameExportFigures},
                                                   {ui_->FormatHits, OwnText::GameExportHits},
                                                   {ui_->FormatJson, OwnText::GameExportJson},
                                                   {ui_->FormatPage, OwnText::GameExportPage},
                                                   {ui_->TableFrame, OwnText::GameExportTable},
                                                   {ui_->SeparatorLabel, OwnText::GameExportSeparator},
                                                   {ui_->ByteOrderMark, OwnText::GameExportByteOrderMark},
                                                   {ui_->PersonalFrame, OwnText::GameExportPersonal},
                                                   {ui_->FullNames, OwnText::GameExportFullNames},
                                                   {ui_->MemberNumbers, OwnText::GameExportMemberNumbers},
                                                   {ui_->Buttons, OwnText::GameExportButtons},
                                                   {ui_->PersonalNote, OwnText::GameExportPersonalNote},
                                                   {ui_->PersonalTicks, OwnText::GameExportPersonalTicks},
                                                   {ui_->ExportButton, OwnText::GameExportButton},
                                                   {ui_->Stop, OwnText::Stop}};
  for (const auto& [control, text] : captions) {
    SetCaptions(parts_.Strings, {{control, static_cast<int>(text)}});
  }
  SetCaptions(parts_.Strings, {{ui_->CloseButton, 137}});
  SetUpGames();
  SetUpForms();
  EnableEntries();
  commands_.Connect(
      *ui_->ExportButton, [this] { Export(); }, WhileBusy::Ignore);
  commands_.EndWaits = [this] { stopped_ = true; };
  connect(ui_->Stop, &QPushButton::clicked, this, [this] { stopped_ = true; });
  connect(ui_->CloseButton, &QPushButton::clicked, this, &QDialog::reject);
}

void ExportGames::SetUpGames() {
  ui_->WhichChosen->setText(QString::fromStdString(
      Filled(parts_.Strings.Text(OwnText::GameExportChosen), {std::to_string(parts_.Chosen.size())})));
  ui_->WhichChosen->setVisible(!parts_.Chosen.empty());
  (parts_.Chosen.empty() ? ui_->WhichThis : ui_->WhichChosen)->setChecked(true);
  const QDate today = DayOf(parts_.Time.Now());
  ui_->From->setDate(QDate(today.year(), today.month(), 1));
  ui_->To->setDate(today);
  for (QDateEdit* day : {ui_->From, ui_->To}) {
    day->setDisplayFormat(DayFormat());
    connect(day, &QDateEdit::dateChanged, this, &ExportGames::EnableEntries);
  }
  for (const QRadioButton* which : {ui_->WhichThis, ui_->WhichChosen, ui_->WhichPeriod}) {
    connect(which, &QRadioButton::toggled, this, &ExportGames::EnableEntries);
  }
  ui_->Progress->hide();
  ui_->Stop->hide();
}

void ExportGames::SetUpForms() {
  for (const auto& [separator, text] : Separators) {
    ui_->Separator->addItem(Text(parts_.Strings, text));
  }
  for (const QRadioButton* format :
       {ui_->FormatPlayers, ui_->FormatFigures, ui_->FormatHits, ui_->FormatJson, ui_->FormatPage}) {
    connect(format, &QRadioButton::toggled, this, &ExportGames::EnableEntries);
  }
}

ExportGames::~ExportGames() = default;

void ExportGames::reject() {
  if (commands_.MayClose()) {
    QDialog::reject();
  }
}

void ExportGames::EnableEntries() {
  const ExportFormat format = Choice().Format;
  ui_->TableFrame->setEnabled(format == ExportFormat::Players || format == ExportFormat::Figures ||
                              format == ExportFormat::Hits);
  ui_->PersonalFrame->setEnabled(format != ExportFormat::Hits);
  for (QWidget* entry : std::initializer_list<QWidget*>{ui_->FromLabel, ui_->From, ui_->ToLabel, ui_->To}) {
    entry->setEnabled(ui_->WhichPeriod->isChecked());
  }
  const bool hasGame = parts_.Game || !ui_->WhichThis->isChecked();
  ui_->ExportButton->setEnabled(hasGame);
  Tell(hasGame ? std::string() : parts_.Strings.Text(OwnText::GameExportNothing));
}

void ExportGames::EnableAll(bool enabled) {
  for (QWidget* frame : std::initializer_list<QWidget*>{ui_->WhichFrame, ui_->FormatFrame, ui_->TableFrame,
                                                        ui_->PersonalFrame, ui_->ExportButton}) {
    frame->setEnabled(enabled);
  }
  ui_->Stop->setVisible(!enabled);
}

ExportChoice ExportGames::Choice() const {
  ExportChoice choice;
  const std::pair<const QRadioButton*, ExportFormat> formats[] = {
      {ui_->FormatPlayers, ExportFormat::Players},
      {ui_->FormatHits, ExportFormat::Hits},
      {ui_->FormatJson, ExportFormat::Json},
      {ui_->FormatPage, ExportFormat::Page},
      {ui_->FormatFigures, ExportFormat::Figures}};
  for (const auto& [button, format] : formats) {
    if (button->isChecked()) {
      choice.Format = format;
    }
  }
  choice.Csv = {.Separator = Separators[ui_->Separator->currentIndex()].first,
                .ByteOrderMark = ui_->ByteOrderMark->isChecked()};
  choice.Personal = {.FullNames = ui_->FullNames->isChecked(),
                     .MemberNumbers = ui_->MemberNumbers->isChecked(),
                     .Buttons = ui_->Buttons->isChecked()};
  return choice;
}

void ExportGames::Export() {
  Tell({});
  const ExportChoice choice = Choice();
  const bool isThis = ui_->WhichThis->isChecked();
  std::vector<std::int64_t> games;
  if (!isThis) {
    games = PastChosen();
    if (games.empty()) {
      Tell(parts_.Strings.Text(OwnText::GameExportNoGames));
      return;
    }
  }
  const auto path = parts_.CommonDialog1.ShowSave({.Filter = ExportFilter(choice.Format, parts_.Strings),
                                                   .Name = ExportFileName(SuggestedName(), choice.Format),
                                                   .Title = parts_.Strings.Text(OwnText::GameExportTitle)});
  if (!path || !MayReplace(*path)) {
    return;
  }
  if (isThis) {
    ExportThis(*path, choice);
  } else {
    ExportPast(*path, choice, games);
  }
}

void ExportGames::ExportThis(const std::string& path, const ExportChoice& choice) {
  {
    const WaitCursor cursor;
    const std::unique_ptr<GameWriter> writer = MakeGameWriter(choice, parts_.Strings);
    parts_.Game([&writer](const ExportedGame& game) { writer->Add(game); });
    writer->End();
    const std::unique_ptr<NewFile> file = parts_.Disk.BeginReplace(path, Readers(choice));
    file->Write(writer->Take());
    file->Finish();
  }
  Tell(Filled(parts_.Strings.Text(OwnText::GameExportSaved), {path}));
}

void ExportGames::ExportPast(const std::string& path, const ExportChoice& choice,
                             const std::vector<std::int64_t>& games) {
  ExportOutcome outcome;
  {
    EnableAll(false);
    const auto ended = qScopeGuard([this] {
      EnableAll(true);
      EnableEntries();
    });
    RunProgress progress(*ui_->Progress, *ui_->Stop, parts_.Events, stopped_);
    ui_->Stop->setFocus();
    const std::unique_ptr<NewFile> file = parts_.Disk.BeginReplace(path, Readers(choice));
    outcome = ExportPastGames(parts_.Past, games, choice, parts_.Strings, *file,
                              [&progress](double done) { return progress.GoOn(done); });
  }
  ui_->ExportButton->setFocus();
  if (!outcome.Complete) {
    Tell(parts_.Strings.Text(OwnText::GameExportStopped));
    return;
  }
  std::string told =
      Filled(parts_.Strings.Text(OwnText::GameExportSavedMany), {std::to_string(outcome.Written), path});
  if (outcome.LeftOut > 0) {
    told.append("  ").append(
        Filled(parts_.Strings.Text(OwnText::GameExportLeftOut), {std::to_string(outcome.LeftOut)}));
  }
  Tell(told);
}

std::vector<std::int64_t> ExportGames::PastChosen() {
  if (ui_->WhichChosen->isChecked()) {
    return parts_.Chosen;
  }
  return parts_.Past.Of(DayIn(*ui_->From), DayIn(*ui_->To));
}

std::string ExportGames::SuggestedName() const {
  if (ui_->WhichThis->isChecked()) {
    return parts_.SuggestedName;
  }
  return ui_->WhichChosen->isChecked() ? "games" : "games " + DayIn(*ui_->From) + " " + DayIn(*ui_->To);
}

FileReaders ExportGames::Readers(const ExportChoice& choice) const {
  return choice.Personal == PersonalData() ? FileReaders::AsBefore : FileReaders::ThisUser;
}

bool ExportGames::MayReplace(const std::string& path) {
  return !parts_.Disk.FileExists(path) ||
         parts_.Boxes.Show(Filled(parts_.Strings.Text(OwnText::GameExportReplaces), {FileNameIn(path)}),
                           DefaultBoxTitle, BoxIcon::Question, BoxButtons::OkCancel) == BoxAnswer::Ok;
}

void ExportGames::Tell(const std::string& text) {
  ui_->OutcomeLine->Show({{QStringLiteral("Outcome"), QString::fromStdString(text)}});
}
