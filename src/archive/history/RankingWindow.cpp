#include "archive/history/RankingWindow.h"

#include <QHeaderView>
#include <QPointer>
#include <QScopeGuard>
#include <filesystem>
#include <utility>

#include "archive/ArchiveQueries.h"
#include "archive/history/HistoryRows.h"
#include "core/text/Filled.h"
#include "platform/RuntimeError.h"
#include "ui/Announce.h"
#include "ui/Captions.h"
#include "ui/RunProgress.h"
#include "ui/Text.h"
#include "ui/WaitCursor.h"
#include "ui_RankingWindow.h"

RankingWindow::RankingWindow(const Parts& parts, QWidget* parent)
    : QDialog(parent),
      parts_(parts),
      ui_(std::make_unique<Ui::RankingWindow>()),
      commands_(*this, parts.Boxes),
      rows_(new HistoryRows(TextList(parts.Strings, OwnText::RankingColumns), {1}, this)) {
  ui_->setupUi(this);
  SetTexts();
  ui_->RankingTable->setModel(rows_);
  ui_->RankingTable->horizontalHeader()->setSectionResizeMode(1, QHeaderView::Stretch);
  FillPeriods();
  const auto refresh = [this] {
    if (!commands_.Running()) {
      commands_.Run([this] { Refresh(); });
    }
  };
  connect(ui_->Period, &QComboBox::currentIndexChanged, this, refresh);
  connect(ui_->Order, &QComboBox::currentIndexChanged, this, refresh);
  connect(ui_->LeastGames, &QSpinBox::valueChanged, this, refresh);
  commands_.Connect(*this,
                    {{ui_->PrintButton, &RankingWindow::Print}, {ui_->ExportButton, &RankingWindow::Export}});
  commands_.EscapePresses(*ui_->CloseButton);
  commands_.EndWaits = [this] { stopped_ = true; };
  connect(ui_->Stop, &QPushButton::clicked, this, [this] { stopped_ = true; });
  ui_->Progress->hide();
  ui_->Stop->hide();
  connect(ui_->CloseButton, &QPushButton::clicked, this, &QDialog::reject);
  refresh();
}

RankingWindow::~RankingWindow() = default;

void RankingWindow::SetTexts() {
  const auto text = [this](OwnText which) { return Text(parts_.Strings, which); };
  setWindowTitle(text(OwnText::RankingsTitle));
  ui_->PeriodLabel->setText(text(OwnText::RankingPeriod));
  ui_->OrderLabel->setText(text(OwnText::RankingBy));
  ui_->LeastLabel->setText(text(OwnText::RankingLeast));
  ui_->Order->addItems(TextList(parts_.Strings, OwnText::RankingOrders));
  ui_->RankingTable->setAccessibleName(text(OwnText::RankingsTitle));
  ui_->NoteLabel->setText(text(OwnText::RankingNote));
  ui_->FullNames->setText(text(OwnText::RankingNames));
  ui_->PrintButton->setText(text(OwnText::RankingPrint));
  ui_->Stop->setText(text(OwnText::Stop));
  ui_->ExportButton->setText(text(OwnText::GameExportButton));
  SetCaptions(parts_.Strings, {{ui_->CloseButton, 137}});
}

void RankingWindow::FillPeriods() {
  constexpr std::size_t yearDigits = 4;
  QStringList months;
  QStringList years;
  try {
    for (const MonthOfGames& month : ArchiveQueries(parts_.Archive()).Months()) {
      months << QString::fromStdString(month.Month);
      const QString year = QString::fromStdString(month.Month.substr(0, yearDigits));
      if (!years.contains(year)) {
        years << year;
      }
    }
  } catch (const RuntimeError&) {
    // The list of members tells it.
  }
  for (const QString& period : months + years) {
    ui_->Period->addItem(period, period);
  }
  ui_->Period->addItem(Text(parts_.Strings, OwnText::RankingAllTime), QString());
}

std::optional<std::vector<RankedFigures>> RankingWindow::Read(RankedBy by) {
  const std::string period = ui_->Period->currentData().toString().toStdString();
  Sql& members = parts_.DbMembers.Statements();
  if (!period.empty()) {
    return InSteps([&](const RankingStep& goOn) { return FiguresInSteps(parts_.Archive(), period, goOn); });
  }
  if (by != RankedBy::Best) {
    return FiguresOfLifetime(members, nullptr);
  }
  return InSteps([&](const RankingStep& goOn) { return LifetimeInSteps(members, parts_.Archive(), goOn); });
}

std::optional<std::vector<RankedFigures>> RankingWindow::InSteps(
    const std::function<std::optional<std::vector<RankedFigures>>(const RankingStep& goOn)>& read) {
  std::optional<RunProgress> progress;
  const QPointer<QWidget> focused = focusWidget();
  const auto ended = qScopeGuard([&] {
    if (progress) {
      progress.reset();
      EnableAll(true);
      if (focused) {
        focused->setFocus();
      }
    }
  });
  return read([&](double done) {
    if (!progress && done > 0) {  // a single step needs none
      EnableAll(false);
      progress.emplace(*ui_->Progress, *ui_->Stop, parts_.Events, stopped_);
      ui_->Stop->setFocus();
    }
    return !progress || progress->GoOn(done);
  });
}

void RankingWindow::EnableAll(bool enabled) {
  for (QWidget* control : std::initializer_list<QWidget*>{ui_->Period, ui_->Order, ui_->LeastGames,
                                                          ui_->RankingTable, ui_->FullNames, ui_->PrintButton,
                                                          ui_->ExportButton, ui_->CloseButton}) {
    control->setEnabled(enabled);
  }
  ui_->Stop->setVisible(!enabled);
}

void RankingWindow::Refresh() {
  const WaitCursor cursor;
  const auto by = static_cast<RankedBy>(ui_->Order->currentIndex());
  std::string state;
  ranked_.clear();
  try {
    if (const std::optional<std::vector<RankedFigures>> figures = Read(by)) {
      ranked_ = Ranked(*figures, by, ui_->LeastGames->value());
      NameRanked(ranked_, parts_.DbMembers, parts_.Hides);
      state = ranked_.empty() ? parts_.Strings.Text(OwnText::RankingNobody) : std::string();
    } else {
      state = parts_.Strings.Text(OwnText::RankingStopped);
    }
  } catch (const RuntimeError& error) {
    ranked_.clear();
    state = error.what();
  }
  rows_->Show(static_cast<int>(ranked_.size()), [this](int row, int column) {
    return QString::fromStdString(RankingTexts(ranked_[static_cast<std::size_t>(row)], parts_.Strings)
                                      .at(static_cast<std::size_t>(column)));
  });
  ui_->RankingTable->FitColumns();
  ui_->PrintButton->setEnabled(!ranked_.empty());
  ui_->ExportButton->setEnabled(!ranked_.empty());
  Tell(state);
}

std::string RankingWindow::Title() const {
  return parts_.Strings.Text(OwnText::RankingsTitle) + " - " + ui_->Period->currentText().toStdString() +
         " - " + ui_->Order->currentText().toStdString();
}

bool RankingWindow::TakeFullNames() {
  const bool wanted = ui_->FullNames->isChecked();
  ui_->FullNames->setChecked(false);
  return wanted;
}

void RankingWindow::Print() {
  parts_.Disk.ReplacePrivately(parts_.PrintedPage,
                               RankingPage(Title(), ranked_, TakeFullNames(), parts_.Strings));
  parts_.OtherPrograms.Start({"xdg-open", parts_.PrintedPage});
}

bool RankingWindow::MayReplace(const std::string& path) {
  const std::string name = std::filesystem::path(path).filename().string();
  return !parts_.Disk.FileExists(path) ||
         parts_.Boxes.Show(Filled(parts_.Strings.Text(OwnText::GameExportReplaces), {name}),
                           windowTitle().toStdString(), BoxIcon::Question,
                           BoxButtons::OkCancel) == BoxAnswer::Ok;
}

void RankingWindow::Export() {
  Tell({});
  const auto path = parts_.CommonDialog1.ShowSave({.Filter = parts_.Strings.Text(OwnText::CsvFilter),
                                                   .Name = Title() + ".csv",
                                                   .Title = parts_.Strings.Text(OwnText::RankingsTitle)});
  if (!path || !MayReplace(*path)) {
    return;
  }
  const bool fullNames = TakeFullNames();
  const std::string csv = RankingCsv(ranked_, fullNames, parts_.Strings);
  if (fullNames) {
    parts_.Disk.ReplacePrivately(*path, csv);
  } else {
    parts_.Disk.Replace(*path, csv);
  }
  Tell(Filled(parts_.Strings.Text(OwnText::GameExportSaved), {*path}));
}

void RankingWindow::Tell(const std::string& text) {
  ui_->StateLabel->setText(QString::fromStdString(text));
  if (!text.empty()) {
    Announce(*ui_->StateLabel);
  }
}

void RankingWindow::reject() {
  if (commands_.MayClose()) {
    QDialog::reject();
  }
}
