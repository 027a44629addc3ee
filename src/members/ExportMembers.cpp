#include "members/ExportMembers.h"

#include <QCheckBox>
#include <QComboBox>
#include <QScopeGuard>
#include <algorithm>
#include <array>
#include <initializer_list>
#include <optional>

#include "core/text/Filled.h"
#include "ui/Announce.h"
#include "ui/RunProgress.h"
#include "ui/Text.h"
#include "ui_ExportMembers.h"

namespace {

constexpr std::array<CsvSeparator, 3> ExportSeparators = {CsvSeparator::Comma, CsvSeparator::Semicolon,
                                                          CsvSeparator::Tab};

/// Some of the numbers, as the operator reads them.
std::string FirstOf(const std::vector<std::string>& numbers) {
  constexpr std::size_t most = 10;
  std::string text;
  for (std::size_t i = 0; i < std::min(most, numbers.size()); ++i) {
    text.append(i == 0 ? "" : ", ").append(numbers[i]);
  }
  return text.append(numbers.size() > most ? ", ..." : "");
}

}  // namespace

ExportMembers::ExportMembers(const Parts& parts, QWidget* parent)
    : QDialog(parent),
      ui_(std::make_unique<Ui::ExportMembers>()),
      parts_(parts),
      commands_(*this, parts_.Boxes),
      rows_(parts_.DbMembers.OpenRecordset("Members")) {
  ui_->setupUi(this);
  SetCaptions();
  commands_.EndWaits = [this] { stopped_ = true; };
  commands_.Connect(
      *ui_->Export, [this] { Export(); }, WhileBusy::Ignore);
  connect(ui_->Stop, &QPushButton::clicked, this, [this] { stopped_ = true; });
}

ExportMembers::~ExportMembers() = default;

void ExportMembers::SetCaptions() {
  const StringTable& strings = parts_.Strings;
  setWindowTitle(Text(strings, OwnText::ExportMembersTitle));
  ui_->SeparatorLabel->setText(Text(strings, OwnText::SeparatorLabel));
  ui_->Separator->addItems(TextList(strings, OwnText::SeparatorNames));
  ui_->Mark->setText(Text(strings, OwnText::MarkForSpreadsheets));
  ui_->History->setText(Text(strings, OwnText::WithPlayingHistory));
  ui_->Stop->setText(Text(strings, OwnText::Stop));
  ui_->Export->setText(Text(strings, OwnText::ExportAction));
  ui_->Cancel->setText(Text(strings, 137));
  ShowState(Filled(strings.Text(OwnText::MembersToExport), {std::to_string(rows_->RecordCount())}));
}

void ExportMembers::reject() {
  if (commands_.MayClose()) {
    QDialog::reject();
  }
}

std::string ExportMembers::AskForPath() {
  constexpr std::size_t dateLength = 10;
  const std::string suggested = "members-" + parts_.Time.Now().substr(0, dateLength) + ".csv";
  std::string path = parts_.CommonDialog1
                         .ShowSave({.Filter = parts_.Strings.Text(OwnText::CsvFilter),
                                    .Name = suggested,
                                    .Title = parts_.Strings.Text(OwnText::ExportMembersTitle)})
                         .value_or(std::string());
  if (path.empty()) {
    return path;
  }
  if (path.find('.', path.rfind('/') + 1) == std::string::npos) {
    path += ".csv";
  }
  const bool isFree =
      !parts_.Disk.FileExists(path) ||
      parts_.Boxes.Show(Filled(parts_.Strings.Text(OwnText::ReplaceFileQuestion), {path}), DefaultBoxTitle,
                        BoxIcon::Question, BoxButtons::OkCancel) == BoxAnswer::Ok;
  return isFree ? path : std::string();
}

void ExportMembers::EnableChoices(bool enabled) {
  for (QWidget* choice :
       std::initializer_list<QWidget*>{ui_->Separator, ui_->Mark, ui_->History, ui_->Export}) {
    choice->setEnabled(enabled);
  }
}

bool ExportMembers::WriteTo(const std::string& path) {
  EnableChoices(false);
  const auto ended = qScopeGuard([this] { EnableChoices(true); });
  const MemberExportForm form{
      .Separator = ExportSeparators.at(static_cast<std::size_t>(ui_->Separator->currentIndex())),
      .ByteOrderMark = ui_->Mark->isChecked(),
      .History = ui_->History->isChecked()};
  RunProgress progress(*ui_->Progress, *ui_->Stop, parts_.Events, stopped_);
  const std::optional<ExportedMembers> members =
      MembersAsCsv(*rows_, form, [&progress](double done) { return progress.GoOn(done); });
  if (members) {
    parts_.Disk.ReplacePrivately(path, members->Csv);
    notReadBack_ = members->NotReadBack;
  }
  return members.has_value();
}

void ExportMembers::Export() {
  const std::string path = AskForPath();
  if (path.empty()) {
    return;
  }
  if (!WriteTo(path)) {
    ShowState(parts_.Strings.Text(OwnText::ExportStopped));
    return;
  }
  std::string text =
      Filled(parts_.Strings.Text(OwnText::MembersExported), {std::to_string(rows_->RecordCount()), path});
  if (!notReadBack_.empty()) {
    text.append("\n\n").append(
        Filled(parts_.Strings.Text(OwnText::MembersNotReadBack), {FirstOf(notReadBack_)}));
  }
  parts_.Boxes.Show(text, DefaultBoxTitle, BoxIcon::Information);
  accept();
}

void ExportMembers::ShowState(const std::string& text) {
  ui_->State->setText(QString::fromStdString(text));
  Announce(*ui_->State);
}
