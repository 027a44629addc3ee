#include "exports/ExportGames.h"

#include <filesystem>
#include <utility>

#include "core/text/Filled.h"
#include "ui/Captions.h"
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

}  // namespace

ExportGames::ExportGames(const Parts& parts, QWidget* parent)
    : QDialog(parent),
      parts_(parts),
      ui_(std::make_unique<Ui::ExportGames>()),
      commands_(*this, parts.Boxes) {
  ui_->setupUi(this);
  const std::pair<QWidget*, OwnText> captions[] = {{this, OwnText::GameExportTitle},
                                                   {ui_->FormatFrame, OwnText::GameExportFormatCaption},
                                                   {ui_->FormatPlayers, OwnText::GameExportPlayers},
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
                                                   {ui_->ExportButton, OwnText::GameExportButton}};
  for (const auto& [control, text] : captions) {
    SetCaptions(parts_.Strings, {{control, static_cast<int>(text)}});
  }
  SetCaptions(parts_.Strings, {{ui_->CloseButton, 137}});
  for (const auto& [separator, text] : Separators) {
    ui_->Separator->addItem(Text(parts_.Strings, text));
  }
  for (const QRadioButton* format : {ui_->FormatPlayers, ui_->FormatHits, ui_->FormatJson, ui_->FormatPage}) {
    connect(format, &QRadioButton::toggled, this, &ExportGames::EnableEntries);
  }
  EnableEntries();
  ui_->ExportButton->setEnabled(parts_.HasGames);
  Tell(parts_.HasGames ? std::string() : parts_.Strings.Text(OwnText::GameExportNothing));
  commands_.Connect(*this, {{ui_->ExportButton, &ExportGames::Export}});
  connect(ui_->CloseButton, &QPushButton::clicked, this, &QDialog::reject);
}

ExportGames::~ExportGames() = default;

void ExportGames::reject() {
  if (commands_.MayClose()) {
    QDialog::reject();
  }
}

void ExportGames::EnableEntries() {
  const ExportFormat format = Choice().Format;
  ui_->TableFrame->setEnabled(format == ExportFormat::Players || format == ExportFormat::Hits);
  ui_->PersonalFrame->setEnabled(format != ExportFormat::Hits);
}

ExportChoice ExportGames::Choice() const {
  ExportChoice choice;
  const std::pair<const QRadioButton*, ExportFormat> formats[] = {{ui_->FormatPlayers, ExportFormat::Players},
                                                                  {ui_->FormatHits, ExportFormat::Hits},
                                                                  {ui_->FormatJson, ExportFormat::Json},
                                                                  {ui_->FormatPage, ExportFormat::Page}};
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
  const auto path =
      parts_.CommonDialog1.ShowSave({.Filter = ExportFilter(choice.Format, parts_.Strings),
                                     .Name = ExportFileName(parts_.SuggestedName, choice.Format),
                                     .Title = parts_.Strings.Text(OwnText::GameExportTitle)});
  if (!path || !MayReplace(*path)) {
    return;
  }
  {
    const WaitCursor cursor;
    const std::string bytes = ExportBytes(parts_.Games, choice, parts_.Strings);
    if (choice.Personal == PersonalData()) {
      parts_.Disk.Replace(*path, bytes);
    } else {
      parts_.Disk.ReplacePrivately(*path, bytes);
    }
  }
  Tell(Filled(parts_.Strings.Text(OwnText::GameExportSaved), {*path}));
}

bool ExportGames::MayReplace(const std::string& path) {
  return !parts_.Disk.FileExists(path) ||
         parts_.Boxes.Show(Filled(parts_.Strings.Text(OwnText::GameExportReplaces), {FileNameIn(path)}),
                           DefaultBoxTitle, BoxIcon::Question, BoxButtons::OkCancel) == BoxAnswer::Ok;
}

void ExportGames::Tell(const std::string& text) {
  ui_->OutcomeLine->Show({{QStringLiteral("Outcome"), QString::fromStdString(text)}});
}
