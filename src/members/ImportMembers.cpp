#include "members/ImportMembers.h"

#include <QComboBox>
#include <QHeaderView>
#include <QScopeGuard>
#include <QShowEvent>
#include <QSignalBlocker>
#include <QTableWidget>
#include <algorithm>
#include <array>
#include <set>
#include <utility>

#include "core/text/Filled.h"
#include "core/text/TextEncoding.h"
#include "members/ImportTexts.h"
#include "members/PlannedRowsModel.h"
#include "platform/RuntimeError.h"
#include "ui/Announce.h"
#include "ui/RunProgress.h"
#include "ui/Text.h"
#include "ui_ImportMembers.h"

namespace {

constexpr std::array<CsvSeparator, 3> Separators = {CsvSeparator::Comma, CsvSeparator::Semicolon,
                                                    CsvSeparator::Tab};
constexpr int UseColumn = 2;

/// The first cells of a column on one line.
QString SampleOf(const MemberImport::FileColumn& column) {
  constexpr std::size_t most = 60;
  std::string sample;
  for (const std::string& cell : column.Cells) {
    sample.append(sample.empty() ? "" : " | ").append(FirstBytes(cell, most));
  }
  return QString::fromStdString(sample).simplified();
}

}  // namespace

ImportMembers::ImportMembers(Parts parts, const std::string& path, std::string bytes, QWidget* parent)
    : QDialog(parent),
      ui_(std::make_unique<Ui::ImportMembers>()),
      parts_(std::move(parts)),
      commands_(*this, parts_.Boxes),
      import_(std::move(bytes), parts_.DbMembers, parts_.Time.Now()),
      rows_(std::make_unique<PlannedRowsModel>(parts_.Strings, nullptr)) {
  ui_->setupUi(this);
  ui_->PlannedRows->setModel(rows_.get());
  SetCaptions(path);
  FillLists();
  ListColumns();
  ConnectControls();
}

ImportMembers::~ImportMembers() = default;

void ImportMembers::SetCaptions(const std::string& path) {
  const StringTable& strings = parts_.Strings;
  setWindowTitle(Text(strings, OwnText::ImportMembersTitle));
  const std::string name = path.substr(path.rfind('/') + 1);
  ui_->ColumnsLabel->setText(QString::fromStdString(Filled(strings.Text(OwnText::ColumnsOfFile), {name})));
  ui_->SeparatorLabel->setText(Text(strings, OwnText::SeparatorLabel));
  ui_->Dates->setTitle(Text(strings, OwnText::OrderOfDates));
  const QStringList orders = TextList(strings, OwnText::DateOrders);
  ui_->DayFirst->setText(orders.at(0));
  ui_->MonthFirst->setText(orders.at(1));
  ui_->SameLabel->setText(Text(strings, OwnText::SameMemberLabel));
  ui_->History->setText(Text(strings, OwnText::ImportHistoryToo));
  ui_->RowsLabel->setText(Text(strings, OwnText::RowsToShow));
  ui_->Shown->setAccessibleName(ui_->RowsLabel->text());
  ui_->CheckAgain->setText(Text(strings, OwnText::CheckAgain));
  ui_->Stop->setText(Text(strings, OwnText::Stop));
  ui_->Import->setText(Text(strings, OwnText::ImportAction));
  ui_->Cancel->setText(Text(strings, 137));
}

void ImportMembers::FillLists() {
  const StringTable& strings = parts_.Strings;
  ui_->Separator->addItems(TextList(strings, OwnText::SeparatorNames));
  ui_->Separator->setCurrentIndex(static_cast<int>(
      std::find(Separators.begin(), Separators.end(), import_.Separator()) - Separators.begin()));
  ui_->Same->addItems(TextList(strings, OwnText::SameMemberChoices));
  ui_->Shown->addItems(TextList(strings, OwnText::RowFateFilters));
  QHeaderView& header = *ui_->PlannedRows->horizontalHeader();
  header.setSectionResizeMode(QHeaderView::Interactive);
  header.setStretchLastSection(true);
  header.setDefaultAlignment(Qt::AlignLeft | Qt::AlignVCenter);
  constexpr int nameWidth = 220;
  header.resizeSection(PlannedRowsModel::NameColumn, nameWidth);
  ui_->PlannedRows->verticalHeader()->hide();
  ui_->PlannedRows->verticalHeader()->setSectionResizeMode(QHeaderView::Fixed);
  ui_->FileColumns->setHorizontalHeaderLabels(TextList(strings, OwnText::FileColumnHeadings));
  ui_->FileColumns->horizontalHeader()->setDefaultAlignment(Qt::AlignLeft | Qt::AlignVCenter);
  ui_->FileColumns->horizontalHeader()->setSectionResizeMode(QHeaderView::Stretch);
  ui_->FileColumns->verticalHeader()->hide();
}

void ImportMembers::ConnectControls() {
  commands_.EndWaits = [this] { stopped_ = true; };
  commands_.Connect(
      *ui_->Import, [this] { Import(); }, WhileBusy::Ignore);
  connect(ui_->CheckAgain, &QPushButton::clicked, this, &ImportMembers::CheckSoon);
  connect(ui_->Stop, &QPushButton::clicked, this, [this] { stopped_ = true; });
  connect(ui_->Separator, &QComboBox::currentIndexChanged, this, [this](int index) {
    import_.SetSeparator(Separators.at(static_cast<std::size_t>(index)));
    ListColumns();
    CheckSoon();
  });
  connect(ui_->Same, &QComboBox::currentIndexChanged, this, &ImportMembers::CheckSoon);
  connect(ui_->History, &QCheckBox::toggled, this, &ImportMembers::CheckSoon);
  connect(ui_->DayFirst, &QRadioButton::clicked, this, [this] { ChooseOrder(DateOrder::DayFirst); });
  connect(ui_->MonthFirst, &QRadioButton::clicked, this, [this] { ChooseOrder(DateOrder::MonthFirst); });
  connect(ui_->Shown, &QComboBox::currentIndexChanged, this, &ImportMembers::ShowPlan);
  checkTimer_.setSingleShot(true);
  connect(&checkTimer_, &QTimer::timeout, this, [this] {
    if (commands_.Running()) {
      CheckSoon();  // the present run ends first
    } else {
      commands_.Run([this] { Check(); });
    }
  });
}

void ImportMembers::ListColumns() {
  const std::vector<MemberImport::FileColumn> columns = import_.Columns();
  const std::vector<std::optional<std::size_t>> matched = MemberImport::Match(columns);
  const std::vector<std::string> titles = MemberColumnTitles(parts_.Strings);
  ui_->FileColumns->setRowCount(0);
  ui_->FileColumns->setRowCount(static_cast<int>(columns.size()));
  QWidget* before = ui_->FileColumns;
  for (std::size_t place = 0; place < columns.size(); ++place) {
    const int row = static_cast<int>(place);
    const QString heading = QString::fromStdString(columns[place].Heading).simplified();
    ui_->FileColumns->setItem(row, 0, new QTableWidgetItem(heading));
    ui_->FileColumns->setItem(row, 1, new QTableWidgetItem(SampleOf(columns[place])));
    auto* use = new QComboBox(ui_->FileColumns);
    use->setObjectName(QStringLiteral("Use%1").arg(row));
    use->setAccessibleName(heading.isEmpty() ? QString::number(row + 1) : heading);
    use->addItem(Text(parts_.Strings, OwnText::ColumnNotUsed));
    for (const std::string& title : titles) {
      use->addItem(QString::fromStdString(title));
    }
    use->setCurrentIndex(matched[place] ? static_cast<int>(*matched[place]) + 1 : 0);
    connect(use, &QComboBox::currentIndexChanged, this, &ImportMembers::CheckSoon);
    ui_->FileColumns->setCellWidget(row, UseColumn, use);
    ui_->FileColumns->setRowHeight(row, use->sizeHint().height());
    setTabOrder(before, use);
    before = use;
  }
}

QComboBox* ImportMembers::UseList(int column) const {
  return qobject_cast<QComboBox*>(ui_->FileColumns->cellWidget(column, UseColumn));
}

ImportChoices ImportMembers::Choices() const {
  ImportChoices choices;
  for (int column = 0; column < ui_->FileColumns->rowCount(); ++column) {
    const int chosen = UseList(column)->currentIndex() - 1;
    choices.Use.Columns.push_back(chosen < 0 ? std::nullopt
                                             : std::optional(static_cast<std::size_t>(chosen)));
  }
  choices.Use.Dates = ui_->MonthFirst->isChecked() ? DateOrder::MonthFirst : DateOrder::DayFirst;
  choices.Use.History = ui_->History->isChecked();
  choices.Same = static_cast<SameMember>(ui_->Same->currentIndex());
  return choices;
}

std::optional<std::size_t> ImportMembers::ColumnUsedTwice(const ColumnUse& use) const {
  std::set<std::size_t> used;
  for (const std::optional<std::size_t> column : use.Columns) {
    if (column && !used.insert(*column).second) {
      return column;
    }
  }
  return std::nullopt;
}

void ImportMembers::showEvent(QShowEvent* event) {
  QDialog::showEvent(event);
  if (!event->spontaneous()) {
    CheckSoon();
  }
}

void ImportMembers::reject() {
  if (commands_.MayClose()) {
    checkTimer_.stop();
    QDialog::reject();
  }
}

void ImportMembers::ChooseOrder(DateOrder order) {
  chosenOrder_ = order;
  CheckSoon();
}

void ImportMembers::EnableChoices(bool enabled) {
  for (QWidget* choice :
       std::initializer_list<QWidget*>{ui_->Separator, ui_->FileColumns, ui_->Dates, ui_->Same, ui_->History,
                                       ui_->Shown, ui_->CheckAgain}) {
    choice->setEnabled(enabled);
  }
}

void ImportMembers::CheckSoon() {
  stopped_ = true;
  rows_->Show(nullptr, std::nullopt);
  plan_.reset();
  ui_->Import->setEnabled(false);
  checkTimer_.start(0);
}

void ImportMembers::Check() {
  const ImportChoices choices = Choices();
  if (const std::optional<std::size_t> twice = ColumnUsedTwice(choices.Use)) {
    ShowState(
        Filled(parts_.Strings.Text(OwnText::ColumnTwice), {MemberColumnTitles(parts_.Strings).at(*twice)}));
    return;
  }
  ShowState(parts_.Strings.Text(OwnText::CheckingFile));
  RunProgress progress(*ui_->Progress, *ui_->Stop, parts_.Events, stopped_);
  const GoOn goOn = [&progress](double done) { return progress.GoOn(done); };
  if (!SettleDates(goOn)) {
    return;
  }
  std::optional<ImportPlan> plan = import_.Plan(Choices(), goOn);
  if (!plan || checkTimer_.isActive()) {
    ShowState(parts_.Strings.Text(OwnText::CheckStopped));
    return;
  }
  plan_ = std::move(plan);
  ui_->Import->setEnabled(plan_->ChangesAnything());
  ShowState(TextOfPlan(*plan_, parts_.Strings));
  ShowPlan();
}

bool ImportMembers::SettleDates(const GoOn& goOn) {
  const std::optional<DateFinding> finding = import_.FindDateOrder(Choices().Use, goOn);
  if (!finding) {
    ShowState(parts_.Strings.Text(OwnText::CheckStopped));
    return false;
  }
  ui_->DatesState->setText(QString::fromStdString(TextOfDates(*finding, parts_.Strings)));
  const bool isDayFirst = finding->IsOpen ? chosenOrder_ == DateOrder::DayFirst : finding->DayFirst != 0;
  const bool isMonthFirst =
      finding->IsOpen ? chosenOrder_ == DateOrder::MonthFirst : finding->MonthFirst != 0;
  for (const auto& [order, isIt] :
       {std::pair{ui_->DayFirst, isDayFirst}, std::pair{ui_->MonthFirst, isMonthFirst}}) {
    order->setAutoExclusive(false);  // both may be without a mark
    order->setChecked(isIt);
    order->setEnabled(finding->IsOpen);
  }
  ui_->DayFirst->setAutoExclusive(finding->IsOpen);
  ui_->MonthFirst->setAutoExclusive(finding->IsOpen);
  if (finding->IsOpen && !chosenOrder_) {
    ShowState(parts_.Strings.Text(OwnText::DatesOpen));
    return false;
  }
  return true;
}

void ImportMembers::ShowPlan() {
  const int shown = ui_->Shown->currentIndex();
  rows_->Show(plan_ ? &*plan_ : nullptr,
              shown == 0 ? std::nullopt : std::optional(static_cast<RowFate>(shown - 1)));
}

void ImportMembers::Import() {
  if (!plan_ || !plan_->ChangesAnything()) {
    return;
  }
  std::optional<ImportPlan> plan;
  ui_->Import->setEnabled(false);
  EnableChoices(false);
  {
    const auto ended = qScopeGuard([this] {
      EnableChoices(true);
      ui_->Import->setEnabled(plan_.has_value());
    });
    RunProgress progress(*ui_->Progress, *ui_->Stop, parts_.Events, stopped_);
    if (!BackUp(progress)) {
      return;
    }
    plan = std::exchange(plan_, std::nullopt);
    rows_->Show(nullptr, std::nullopt);
    const auto stopped = qScopeGuard([this] {
      if (!hasImported_) {
        ShowState(parts_.Strings.Text(OwnText::ImportStopped));
      }
    });
    hasImported_ = import_.Write(Choices(), *plan, [&progress](double done) { return progress.GoOn(done); });
  }
  if (!hasImported_) {
    return;
  }
  parts_.Boxes.Show(
      Filled(parts_.Strings.Text(OwnText::MembersImported),
             {std::to_string(plan->Count(RowFate::New)), std::to_string(plan->Count(RowFate::Changed))}),
      DefaultBoxTitle, BoxIcon::Information);
  accept();
}

bool ImportMembers::BackUp(RunProgress& progress) {
  ShowState(parts_.Strings.Text(OwnText::ImportingMembers));
  try {
    if (parts_.BackUp([&progress] { return progress.GoOn(0); })) {
      return true;
    }
    ShowState(parts_.Strings.Text(OwnText::ImportStopped));
  } catch (const RuntimeError& error) {
    ShowState(TextOfPlan(*plan_, parts_.Strings));
    parts_.Boxes.Show(Filled(parts_.Strings.Text(OwnText::ImportCopyFailed), {error.what()}), DefaultBoxTitle,
                      BoxIcon::Exclamation);
  }
  return false;
}

void ImportMembers::ShowState(const std::string& text) {
  ui_->State->setText(QString::fromStdString(text));
  Announce(*ui_->State);
}
