#include "archive/history/MemberHistoryWindow.h"

#include <QDateTime>
#include <QHeaderView>
#include <QLocale>
#include <algorithm>
#include <utility>

#include "archive/history/HistoryRows.h"
#include "archive/history/LifetimeSums.h"
#include "core/text/Filled.h"
#include "core/text/NumberForms.h"
#include "platform/RuntimeError.h"
#include "platform/qt/QtClock.h"
#include "ui/Announce.h"
#include "ui/Text.h"
#include "ui_MemberHistoryWindow.h"

namespace {

constexpr int CloseText = 137;

/// A time of the archive as the operator's locale tells it.
std::string ShownTime(const std::string& played) {
  const QDateTime time =
      QDateTime::fromString(QString::fromStdString(played), QStringLiteral("yyyy-MM-dd HH:mm:ss"));
  if (!time.isValid()) {
    return played;
  }
  const QLocale locale = QLocale::system();
  return ShortDateText(locale, time.date()) + " " + ShortTimeText(locale, time.time());
}

std::string MeanText(double mean) {
  return FormatFixed(mean, 1);
}

std::string ShownAccuracy(const std::optional<double>& accuracy) {
  return accuracy ? FormatPercent(*accuracy) : std::string();
}

/// The row of a table for the place on a chart of `count`, and the other way round: the latest is on top
/// there and at the right end here.
int Mirrored(int place, int count) {
  return count - 1 - place;
}

}  // namespace

MemberHistoryWindow::MemberHistoryWindow(const Parts& parts, std::int32_t member, QWidget* parent)
    : QDialog(parent),
      parts_(parts),
      ui_(std::make_unique<Ui::MemberHistoryWindow>()),
      commands_(*this, parts.Boxes),
      memberRows_(new HistoryRows(TextList(Strings(), OwnText::HistoryMemberColumns), {0}, this)),
      sessionRows_(new HistoryRows(TextList(Strings(), OwnText::SessionColumns), {0, 1, 7}, this)),
      monthRows_(new HistoryRows(TextList(Strings(), OwnText::MonthColumns), {0}, this)) {
  ui_->setupUi(this);
  SetTexts();
  SetUpTables();
  ConnectCharts();
  ui_->ForgetProgress->hide();
  ui_->StopButton->setEnabled(false);
  commands_.Connect(
      *ui_->ForgetButton, [this] { Forget(); }, WhileBusy::Ignore);
  commands_.EndWaits = [this] { stopped_ = true; };
  connect(ui_->StopButton, &QPushButton::clicked, this, [this] { stopped_ = true; });
  commands_.EscapePresses(*ui_->CloseButton);
  connect(ui_->CloseButton, &QPushButton::clicked, this, &QDialog::reject);
  Load(member);
}

MemberHistoryWindow::~MemberHistoryWindow() = default;

void MemberHistoryWindow::SetTexts() {
  const auto text = [this](OwnText which) { return Text(Strings(), which); };
  setWindowTitle(text(OwnText::MemberHistoryTitle));
  ui_->FindEntry->setPlaceholderText(text(OwnText::HistoryFind));
  ui_->FindEntry->setAccessibleName(text(OwnText::HistoryFind));
  ui_->MemberTable->setAccessibleName(text(OwnText::HistoryMembers));
  ui_->Tabs->setTabText(0, text(OwnText::SessionsTab));
  ui_->Tabs->setTabText(1, text(OwnText::MonthsTab));
  ui_->CurveLabel->setText(text(OwnText::HistoryCurve));
  ui_->BarsLabel->setText(text(OwnText::HistoryBars));
  ui_->SessionTable->setAccessibleName(text(OwnText::SessionsTab));
  ui_->MonthTable->setAccessibleName(text(OwnText::MonthsTab));
  ui_->Curve->SetUp(HistoryChart::Kind::Curve, text(OwnText::HistoryCurve), text(OwnText::HistoryKeys));
  ui_->Bars->SetUp(HistoryChart::Kind::Bars, text(OwnText::HistoryBars), text(OwnText::HistoryKeys));
  ui_->ForgetButton->setText(text(OwnText::ForgetButton));
  ui_->StopButton->setText(text(OwnText::Stop));
  ui_->ForgetProgress->setAccessibleName(text(OwnText::ForgetButton).remove(u'&'));
  ui_->CloseButton->setText(Text(Strings(), CloseText));
}

void MemberHistoryWindow::SetUpTables() {
  ui_->MemberTable->setModel(memberRows_);
  ui_->SessionTable->setModel(sessionRows_);
  ui_->MonthTable->setModel(monthRows_);
  ui_->MemberTable->horizontalHeader()->setSectionResizeMode(0, QHeaderView::Stretch);
  ui_->MemberTable->setSelectionMode(QAbstractItemView::SingleSelection);
  constexpr int list = 2;
  constexpr int history = 5;
  ui_->Splitter->setSizes({list * width(), history * width()});  // shares of what there is
  connect(ui_->MemberTable->selectionModel(), &QItemSelectionModel::currentRowChanged, this,
          [this] { commands_.Run([this] { ShowCurrent(); }); });
  connect(ui_->FindEntry, &QLineEdit::textChanged, this, [this] { commands_.Run([this] { Filter(); }); });
}

void MemberHistoryWindow::ConnectCharts() {
  const auto follow = [this](HistoryChart& chart, ChartTable& table, const HistoryRows& rows) {
    connect(&chart, &HistoryChart::Told, this, [&](const QString& text, bool chosen) {
      ui_->TellLabel->setText(text);
      if (chosen) {
        Announce(*ui_->TellLabel);
        table.GoTo(Mirrored(*chart.Place(), rows.rowCount()));
      }
    });
    connect(&table, &ChartTable::RowReached, this,
            [&](int row) { chart.SetPlace(Mirrored(row, rows.rowCount())); });
  };
  follow(*ui_->Curve, *ui_->SessionTable, *sessionRows_);
  follow(*ui_->Bars, *ui_->MonthTable, *monthRows_);
}

std::string MemberHistoryWindow::NameOf(const ArchivedMember& member) const {
  const std::string name = member.IsMember ? member.Name : Strings().Text(OwnText::HistoryGoneMember);
  return name.empty() ? std::to_string(member.Number) : name + " (" + std::to_string(member.Number) + ")";
}

void MemberHistoryWindow::Load(std::int32_t member) {
  members_.clear();
  std::string failure;
  try {
    members_ = ArchivedMembers(parts_.Archive(), DbMembers());
    if (member != 0) {
      IncludeMember(members_, member, DbMembers());
    }
  } catch (const RuntimeError& error) {
    failure = error.what();
  }
  Filter();
  ui_->MemberTable->FitColumns();
  Select(member);
  if (!failure.empty()) {
    Tell(failure);
  } else if (members_.empty()) {
    Tell(Strings().Text(OwnText::HistoryNoMembers));
  }
}

void MemberHistoryWindow::Filter() {
  const std::string text = ui_->FindEntry->text().trimmed().toStdString();
  found_.clear();
  for (std::size_t place = 0; place < members_.size(); ++place) {
    if (IsFound(members_[place], text)) {
      found_.push_back(place);
    }
  }
  memberRows_->Show(static_cast<int>(found_.size()), [this](int row, int column) {
    const ArchivedMember& member = members_[found_[static_cast<std::size_t>(row)]];
    if (column == 1) {
      return QString::number(member.Number);
    }
    return member.IsMember ? QString::fromStdString(member.Name)
                           : Text(Strings(), OwnText::HistoryGoneMember);
  });
  Select(shown_.Number);
}

void MemberHistoryWindow::Select(std::int32_t member) {
  const auto row = std::ranges::find_if(
      found_, [this, member](std::size_t place) { return members_[place].Number == member; });
  const int place = row == found_.end() ? 0 : static_cast<int>(row - found_.begin());
  if (found_.empty()) {
    Clear();
    return;
  }
  ui_->MemberTable->selectRow(place);
  ui_->MemberTable->scrollTo(memberRows_->index(place, 0));
  ShowCurrent();
}

void MemberHistoryWindow::ShowCurrent() {
  const QModelIndex current = ui_->MemberTable->currentIndex();
  if (!current.isValid() || current.row() >= memberRows_->rowCount()) {
    return;
  }
  const ArchivedMember& member = members_[found_[static_cast<std::size_t>(current.row())]];
  if (member.Number == shown_.Number) {
    return;
  }
  try {
    Show(member);
  } catch (const RuntimeError& error) {
    Tell(error.what());
  }
}

void MemberHistoryWindow::Clear() {
  shown_ = {};
  sessions_ = {};
  ui_->MemberLabel->clear();
  ui_->LifetimeLabel->clear();
  ui_->ForgetButton->setEnabled(false);
  ShowSessions();
  ShowMonths();
  ShowBests();
}

void MemberHistoryWindow::Show(const ArchivedMember& member) {
  Clear();
  shown_ = member;
  ui_->MemberLabel->setText(QString::fromStdString(NameOf(member)));
  Sql& archive = parts_.Archive();
  sessions_ = SessionsFrom(ArchiveQueries(archive).GamesOf(member.Number));
  QStringList lines;
  for (const std::string& line : LifetimeTexts(
           ReadLifetimeSums(sessions_.Games, member.Number, archive, DbMembers().Statements()), Strings())) {
    lines << QString::fromStdString(line);
  }
  ui_->LifetimeLabel->setText(lines.join(u'\n'));
  ui_->ForgetButton->setEnabled(true);
  ShowSessions();
  ShowMonths();
  ShowBests();
  Tell(sessions_.Games.empty() ? Strings().Text(OwnText::HistoryNoGames) : std::string());
}

void MemberHistoryWindow::ShowSessions() {
  const int count = static_cast<int>(sessions_.Games.size());
  sessionRows_->Show(count, [this](int row, int column) { return SessionText(row, column); });
  ui_->SessionTable->FitColumns();
  std::vector<HistoryPoint> points;
  for (int place = 0; place < count; ++place) {
    const auto row = static_cast<std::size_t>(Mirrored(place, count));
    const MemberGame& game = sessions_.Games[row];
    const std::string text =
        Filled(Strings().Text(OwnText::SessionTold),
               {ShownTime(game.Played), std::to_string(game.Soldiering), MeanText(sessions_.MeansSoFar[row]),
                Filled(Strings().Text(OwnText::PlaceOfPlayers),
                       {std::to_string(game.Place), std::to_string(game.Players)})});
    constexpr std::size_t dateLength = 10;
    points.push_back({.Label = QString::fromStdString(game.Played.substr(0, dateLength)),
                      .Value = static_cast<double>(game.Soldiering),
                      .Mean = sessions_.MeansSoFar[row],
                      .Text = QString::fromStdString(text)});
  }
  ui_->Curve->SetPoints(std::move(points));
}

void MemberHistoryWindow::ShowMonths() {
  const int count = static_cast<int>(sessions_.Months.size());
  monthRows_->Show(count, [this](int row, int column) { return MonthText(row, column); });
  ui_->MonthTable->FitColumns();
  std::vector<HistoryPoint> points;
  for (int place = 0; place < count; ++place) {
    const MonthOfMember& month = sessions_.Months[static_cast<std::size_t>(Mirrored(place, count))];
    const std::string text = Filled(Strings().Text(OwnText::MonthTold),
                                    {month.Month, MeanText(month.Mean()), std::to_string(month.Games),
                                     std::to_string(month.SoldieringBest)});
    points.push_back({.Label = QString::fromStdString(month.Month),
                      .Value = month.Mean(),
                      .Text = QString::fromStdString(text)});
  }
  ui_->Bars->SetPoints(std::move(points));
}

void MemberHistoryWindow::ShowBests() {
  QStringList lines;
  const auto add = [&](OwnText text, const std::optional<std::size_t>& place, const auto& figureOf) {
    if (place) {
      const MemberGame& game = sessions_.Games[*place];
      lines << QString::fromStdString(
          Filled(Strings().Text(text), {std::string(figureOf(game)), ShownTime(game.Played)}));
    }
  };
  add(OwnText::HistoryBest, sessions_.BestSoldiering,
      [](const MemberGame& game) { return std::to_string(game.Soldiering); });
  add(OwnText::HistoryBestAccuracy, sessions_.BestAccuracy,
      [](const MemberGame& game) { return ShownAccuracy(game.Accuracy); });
  add(OwnText::HistoryMostDamage, sessions_.MostDamage,
      [](const MemberGame& game) { return std::to_string(game.Damage); });
  ui_->BestLabel->setText(lines.join(u'\n'));
}

QString MemberHistoryWindow::SessionText(int row, int column) const {
  const auto place = static_cast<std::size_t>(row);
  const MemberGame& game = sessions_.Games[place];
  const std::string texts[] = {ShownTime(game.Played),
                               game.Mission,
                               Filled(Strings().Text(OwnText::PlaceOfPlayers),
                                      {std::to_string(game.Place), std::to_string(game.Players)}),
                               std::to_string(game.Soldiering),
                               MeanText(sessions_.MeansSoFar[place]),
                               ShownAccuracy(game.Accuracy),
                               std::to_string(game.Damage),
                               game.Committed ? Strings().Text(OwnText::OwnTeamYes) : std::string()};
  return QString::fromStdString(texts[column]);
}

QString MemberHistoryWindow::MonthText(int row, int column) const {
  const MonthOfMember& month = sessions_.Months[static_cast<std::size_t>(row)];
  const std::string texts[] = {month.Month,
                               std::to_string(month.Games),
                               MeanText(month.Mean()),
                               std::to_string(month.SoldieringBest),
                               ShownAccuracy(month.Accuracy()),
                               std::to_string(month.Damage)};
  return QString::fromStdString(texts[column]);
}

void MemberHistoryWindow::Tell(const std::string& text) {
  ui_->TellLabel->setText(QString::fromStdString(text));
  if (!text.empty()) {
    Announce(*ui_->TellLabel);
  }
}

void MemberHistoryWindow::reject() {
  if (commands_.MayClose()) {
    QDialog::reject();
  }
}
