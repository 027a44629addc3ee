#include "archive/past/PastGames.h"

#include <QHeaderView>
#include <QScopedValueRollback>
#include <QShortcut>
#include <QTimer>
#include <algorithm>
#include <set>
#include <utility>

#include "archive/DeletedGames.h"
#include "archive/past/PastTables.h"
#include "core/gamefile/SuggestedName.h"
#include "core/text/Filled.h"
#include "platform/RuntimeError.h"
#include "ui/Announce.h"
#include "ui/Captions.h"
#include "ui/Text.h"
#include "ui_PastGames.h"

PastGames::PastGames(Parts parts, QWidget* parent)
    : QDialog(parent),
      ui_(std::make_unique<Ui::PastGames>()),
      parts_(std::move(parts)),
      months_(parts_.Strings),
      games_({.Read = [this](std::int64_t game) { return parts_.Archive.Queries().Game(game); },
              .NickNameOf = parts_.Archive.Names(),
              .GuestNameOf = [this](std::int64_t game,
                                    int index) { return parts_.Archive.GuestNameOf(game, index); },
              // Not in the middle of painting.
              .Failed =
                  [this](const std::string& reason) {
                    QTimer::singleShot(0, this, [this, reason] { TellFailure(reason); });
                  }},
             parts_.Strings),
      board_(parts_.Strings),
      commands_(*this, parts_.Boxes) {
  ui_->setupUi(this);
  SetTexts();
  SetUpSearch();
  SetUpTables();
  ConnectCommands();
  Refresh(0);
  ui_->GameTable->setFocus();
}

PastGames::~PastGames() {
  parts_.Archive.Close();
}

void PastGames::SetTexts() {
  const auto own = [](OwnText text) { return static_cast<int>(text); };
  SetCaptions(parts_.Strings, {{this, own(OwnText::PastGamesTitle)},
                               {ui_->FromLabel, own(OwnText::PastFrom)},
                               {ui_->UntilLabel, own(OwnText::PastUntil)},
                               {ui_->MissionLabel, own(OwnText::PastMission)},
                               {ui_->MemberLabel, own(OwnText::PastMember)},
                               {ui_->GunLabel, own(OwnText::PastGun)},
                               {ui_->Search, own(OwnText::PastSearchButton)},
                               {ui_->ShowAll, own(OwnText::PastShowAll)},
                               {ui_->MonthLabel, own(OwnText::PastMonths)},
                               {ui_->GameLabel, own(OwnText::PastList)},
                               {ui_->StateLabel, own(OwnText::PastState)},
                               {ui_->Open, own(OwnText::PastOpen)},
                               {ui_->SaveFile, own(OwnText::PastSaveFile)},
                               {ui_->Charts, own(OwnText::PastCharts)},
                               {ui_->Export, own(OwnText::PastExport)},
                               {ui_->Delete, own(OwnText::PastDelete)},
                               {ui_->BringBack, own(OwnText::PastBringBack)},
                               {ui_->Import, own(OwnText::PastImport)},
                               {ui_->Stop, own(OwnText::Stop)},
                               {ui_->Close, 137}});
  ui_->BoardTable->setAccessibleName(Text(parts_.Strings, 203));
  ui_->Import->setVisible(parts_.Import != nullptr);
}

void PastGames::SetUpSearch() {
  const QString today = QString::fromStdString(parts_.Time.ShortDate());
  ui_->SearchFrom->setPlaceholderText(today);
  ui_->SearchUntil->setPlaceholderText(today);
  ui_->SearchMission->addItem(Text(parts_.Strings, OwnText::PastAnyMission));
  ui_->SearchTeam->addItem(Text(parts_.Strings, OwnText::PastAnyGun));
  for (std::int16_t team = 1; team <= TeamCount; ++team) {
    ui_->SearchTeam->addItem(QString::fromStdString(TeamNameFromNumber(parts_.Strings, team)));
  }
  ui_->SearchNumber->setAccessibleName(ui_->GunLabel->text().remove(QLatin1Char('&')));
  const auto setTeam = [this](int team) {
    ui_->SearchNumber->setEnabled(team > 0);
    ui_->SearchNumber->setMaximum(MaxPlayerNumber(static_cast<std::int16_t>(team)));
  };
  connect(ui_->SearchTeam, &QComboBox::currentIndexChanged, this, setTeam);
  setTeam(0);
}

void PastGames::FillMissions() {
  // Those that are listed stay: one of them may be chosen.
  int place = 1;
  for (const std::string& mission : parts_.Archive.Queries().Missions()) {
    const QString name = QString::fromStdString(mission);
    const int listed = ui_->SearchMission->findData(name);
    if (listed < 0) {
      ui_->SearchMission->insertItem(place, name, name);
    }
    place = (listed < 0 ? place : listed) + 1;
  }
}

void PastGames::SetUpTables() {
  ui_->MonthTable->setModel(&months_);
  ui_->GameTable->setModel(&games_);
  ui_->BoardTable->setModel(&board_);
  SetUpMonthTable(*ui_->MonthTable);
  SetUpGameTable(*ui_->GameTable);
  SetUpBoardTable(*ui_->BoardTable);
  connect(ui_->MonthTable->selectionModel(), &QItemSelectionModel::currentRowChanged, this, [this] {
    if (!listing_) {
      ListGames(0);
    }
  });
  connect(ui_->GameTable->selectionModel(), &QItemSelectionModel::currentRowChanged, this, [this] {
    if (!listing_) {
      ShowGame();
    }
  });
  connect(ui_->GameTable->selectionModel(), &QItemSelectionModel::selectionChanged, this,
          &PastGames::EnableButtons);
  connect(ui_->State, &QComboBox::currentIndexChanged, this, [this] {
    if (!listing_) {
      ShowBoard();
    }
  });
}

void PastGames::ConnectCommands() {
  const auto connectButton = [this](QPushButton& button, void (PastGames::*command)()) {
    commands_.Connect(
        button, [this, command] { Try([this, command] { (this->*command)(); }); }, WhileBusy::Ignore);
  };
  connectButton(*ui_->Search, &PastGames::Search);
  connectButton(*ui_->ShowAll, &PastGames::ShowAll);
  connectButton(*ui_->Open, &PastGames::OpenGame);
  connectButton(*ui_->SaveFile, &PastGames::SaveFile);
  connectButton(*ui_->Charts, &PastGames::ShowCharts);
  connectButton(*ui_->Export, &PastGames::Export);
  connectButton(*ui_->Delete, &PastGames::Delete);
  connectButton(*ui_->BringBack, &PastGames::BringBack);
  connectButton(*ui_->Import, &PastGames::Import);
  connect(ui_->Close, &QPushButton::clicked, this, &QDialog::reject);
  commands_.EscapePresses(*ui_->Close);
  for (QLineEdit* entry : {ui_->SearchFrom, ui_->SearchUntil, ui_->SearchMember}) {
    connect(entry, &QLineEdit::returnPressed, ui_->Search, &QPushButton::click);
  }
  connect(ui_->GameTable, &QTableView::activated, ui_->Open, &QPushButton::click);
  const auto* remove =
      new QShortcut(QKeySequence::Delete, ui_->GameTable, nullptr, nullptr, Qt::WidgetShortcut);
  connect(remove, &QShortcut::activated, ui_->Delete, &QPushButton::click);
  for (QTableView* list : {ui_->GameTable, ui_->BoardTable}) {
    OnCopyKey(*list, [this, list] {
      if (!commands_.Running()) {
        commands_.Run([this, list] { Try([this, list] { Copy(*list); }); });
      }
    });
  }
  commands_.EndWaits = [this] { stopped_ = true; };
  connect(ui_->Stop, &QPushButton::clicked, this, [this] { stopped_ = true; });
  ui_->Progress->hide();
  ui_->Stop->hide();
}

void PastGames::Refresh(std::int64_t stay) {
  parts_.Archive.Close();  // another file may have taken its place
  const PastMonthModel::Entry before =
      ui_->MonthTable->currentIndex().isValid() ? Listed() : PastMonthModel::Entry{ListedPast::Month};
  std::vector<MonthOfGames> months;
  const bool done = Try([&] {
    months = parts_.Archive.Queries().Months();
    FillMissions();
  });
  {
    const QScopedValueRollback guard(listing_, true);
    months_.Show(months);
    ui_->MonthTable->selectRow(months_.RowOf(before));
  }
  if (done) {
    ListGames(stay);
  } else {
    games_.Show({});
    ShowGame();
  }
}

void PastGames::ListGames(std::int64_t stay) {
  std::vector<std::int64_t> games;
  Tell({});
  stopped_ = false;
  const bool done = Try([&] {
    const GameFilter filter = FilterOf(search_, Listed().Which, Listed().Month);
    RunInSteps(AreMany(filter.Members.size()),
               [&](const Step& goOn) { games = parts_.Archive.Queries().Games(filter, goOn); });
  });
  {
    const QScopedValueRollback guard(listing_, true);
    games_.Show(std::move(games));
    if (games_.rowCount() > 0) {
      ui_->GameTable->selectRow(std::max(games_.RowOf(stay), 0));
    }
  }
  ShowGame();
  if (stopped_) {
    Tell(parts_.Strings.Text(OwnText::PastSearchStopped));
  } else if (done && games_.rowCount() == 0) {
    TellOfEmptyList();
  }
}

void PastGames::TellOfEmptyList() {
  const StringTable& strings = parts_.Strings;
  if (Listed().Which == ListedPast::Deleted) {
    Tell(Filled(strings.Text(OwnText::PastNoneDeleted), {std::to_string(DaysOfDeletedGames)}));
  } else {
    Tell(strings.Text(search_ == PastSearch() ? OwnText::PastNone : OwnText::PastNothingFound));
  }
}

void PastGames::ShowGame() {
  const QModelIndex current = ui_->GameTable->currentIndex();
  FillStates(current.isValid() ? games_.GameIn(current.row()) : nullptr);
  ShowBoard();
}

void PastGames::FillStates(const ListedGame* game) {
  const QScopedValueRollback guard(listing_, true);
  const StringTable& strings = parts_.Strings;
  const int earlier = game != nullptr ? game->EarlierStates : 0;
  ui_->State->clear();
  ui_->State->addItem(Text(strings, OwnText::PastLastState), 0);
  for (int state = earlier; state >= 1; --state) {
    ui_->State->addItem(
        QString::fromStdString(Filled(strings.Text(OwnText::PastEarlierState), {std::to_string(state)})),
        state);
  }
  ui_->State->setVisible(earlier > 0);
  ui_->StateLabel->setVisible(earlier > 0);
  ui_->State->adjustSize();
}

void PastGames::ShowBoard() {
  board_.ShowNothing();
  ui_->BoardLabel->clear();
  if (const std::int64_t game = CurrentGame(); game != 0) {
    Try([&] { board_.Show(parts_.Archive.Read(game, CurrentState()), parts_.Archive.Names()); });
  }
  if (const PastGame* shown = board_.Shown()) {
    ui_->BoardLabel->setText(PastGameModel::TimeText(shown->Played) +
                             QString::fromStdString(", " + shown->Mission));
  }
  EnableButtons();
}

void PastGames::EnableButtons() {
  const bool deleted = Listed().Which == ListedPast::Deleted;
  const bool isShown = board_.Shown() != nullptr;
  const bool selected = ui_->GameTable->selectionModel()->hasSelection();
  ui_->Open->setEnabled(isShown && !deleted);
  ui_->SaveFile->setEnabled(isShown);
  ui_->Charts->setEnabled(isShown);
  ui_->Export->setEnabled(selected && !deleted);
  ui_->Delete->setEnabled(selected && !deleted);
  ui_->Delete->setVisible(!deleted);
  ui_->BringBack->setEnabled(selected && deleted);
  ui_->BringBack->setVisible(deleted);
}

std::optional<PastSearch> PastGames::SearchOfEntries() {
  PastSearch search{.Mission = ui_->SearchMission->currentData().toString().toStdString()};
  if (!ReadDay(*ui_->SearchFrom, search.From) || !ReadDay(*ui_->SearchUntil, search.Until)) {
    return std::nullopt;
  }
  if (const std::string member = ui_->SearchMember->text().trimmed().toStdString(); !member.empty()) {
    search.Members = parts_.MembersCalled(member);
    if (search.Members.empty()) {
      Tell(Filled(parts_.Strings.Text(OwnText::PastNoMember), {member}));
      ui_->SearchMember->setFocus();
      return std::nullopt;
    }
  }
  if (const int team = ui_->SearchTeam->currentIndex(); team > 0) {
    search.Player = IndexFromId(IdFromTeamAndNumber(static_cast<std::uint8_t>(team),
                                                    static_cast<std::uint8_t>(ui_->SearchNumber->value())));
  }
  return search;
}

bool PastGames::ReadDay(QLineEdit& entry, std::string& day) {
  const std::string text = entry.text().trimmed().toStdString();
  if (text.empty()) {
    return true;
  }
  day = DayOf(parts_.Time.Stamp(text));
  if (day.empty()) {
    Tell(Filled(parts_.Strings.Text(OwnText::PastNoDate), {text, parts_.Time.ShortDate()}));
    entry.setFocus();
    entry.selectAll();
  }
  return !day.empty();
}

void PastGames::Search() {
  const std::optional<PastSearch> search = SearchOfEntries();
  if (!search) {
    return;
  }
  search_ = *search;
  if (Listed().Which == ListedPast::Month) {
    const QScopedValueRollback guard(listing_, true);
    ui_->MonthTable->selectRow(months_.RowOf({ListedPast::All}));
  }
  Refresh(CurrentGame());
  ui_->GameTable->setFocus();
}

void PastGames::ShowAll() {
  for (QLineEdit* entry : {ui_->SearchFrom, ui_->SearchUntil, ui_->SearchMember}) {
    entry->clear();
  }
  ui_->SearchMission->setCurrentIndex(0);
  ui_->SearchTeam->setCurrentIndex(0);
  Search();
}

bool PastGames::Try(const std::function<void()>& action) {
  try {
    action();
    return true;
  } catch (const RuntimeError& error) {
    TellFailure(error.what());
    return false;
  }
}

void PastGames::TellFailure(const std::string& reason) {
  Tell(Filled(parts_.Strings.Text(OwnText::PastFailed), {reason}));
}

void PastGames::Tell(const std::string& text) {
  const std::string& unusable = parts_.Archive.Unusable();
  const bool isOther = text.empty() && !unusable.empty();
  ui_->Status->setText(QString::fromStdString(
      isOther ? Filled(parts_.Strings.Text(OwnText::PastUnusable), {unusable}) : text));
  if (!ui_->Status->text().isEmpty()) {
    Announce(*ui_->Status);
  }
}

const PastMonthModel::Entry& PastGames::Listed() const {
  return months_.At(std::max(ui_->MonthTable->currentIndex().row(), 0));
}

std::int64_t PastGames::CurrentGame() const {
  const QModelIndex current = ui_->GameTable->currentIndex();
  return current.isValid() ? games_.Games()[static_cast<std::size_t>(current.row())] : 0;
}

std::int64_t PastGames::CurrentState() const {
  return ui_->State->currentData().toLongLong();
}

std::vector<std::int64_t> PastGames::SelectedGames() const {
  // By ranges: an index for each of a hundred thousand rows takes its time.
  std::set<int> rows;
  for (const QItemSelectionRange& range : ui_->GameTable->selectionModel()->selection()) {
    for (int row = range.top(); row <= range.bottom(); ++row) {
      rows.insert(rows.end(), row);
    }
  }
  std::vector<std::int64_t> games;
  games.reserve(rows.size());
  for (const int row : rows) {
    games.push_back(games_.Games()[static_cast<std::size_t>(row)]);
  }
  return games;
}

void PastGames::reject() {
  if (commands_.MayClose()) {
    QDialog::reject();
  }
}
