#include "board/BoardPane.h"

#include <QAbstractItemModel>
#include <QBoxLayout>
#include <QHeaderView>
#include <QScrollBar>
#include <algorithm>
#include <cmath>

#include "board/BoardLetters.h"
#include "board/ScoreListView.h"
#include "core/game/Game.h"

namespace {

/// Pixels between the parts of players and teams.
constexpr int Between = 16;
constexpr int Below = 6;

}  // namespace

void BoardPane::SetLists(ScoreListView& players, ScoreListView& teams, QBoxLayout& parts) {
  players_ = &players;
  teams_ = &teams;
  parts_ = &parts;
  connect(players.model(), &QAbstractItemModel::modelReset, this, [this] {
    if (players_->model()->rowCount() > 0) {  // else for the moment only, if a calculation has emptied it
      Arrange();
    }
  });
  Arrange();
}

void BoardPane::SetLetters(int percent) {
  letters_ = percent;
  Arrange();
}

void BoardPane::MakeLettersLarger() {
  Choose(LargerPercent(letters_));
}

void BoardPane::MakeLettersSmaller() {
  if (ChosenSize(beside_, SmallerPercent(letters_)) != ChosenSize(beside_, letters_)) {
    Choose(SmallerPercent(letters_));
  }
}

void BoardPane::MakeLettersUsual() {
  Choose(UsualPercent);
}

void BoardPane::Choose(int percent) {
  SetLetters(percent);
  emit LettersChosen();
}

void BoardPane::resizeEvent(QResizeEvent* event) {
  QWidget::resizeEvent(event);
  Arrange();
}

void BoardPane::Arrange() {
  if (players_ == nullptr) {
    return;
  }
  constexpr double captionsOfHeight = 0.02;
  // Whole pixels: each size of letters has glyphs of its own.
  const int pixels = static_cast<int>(height() * captionsOfHeight);
  const double captions = static_cast<double>(pixels) / players_->LeastLetters();
  players_->SetLargestCaptions(captions);
  teams_->SetLargestCaptions(captions);
  const bool beside = TeamsStandBeside(width(), height(), players_->LeastLetters());
  ShowTeamsBeside(beside);
  const Size size = ChosenSize(beside, letters_);
  players_->SetLetters(size.Growth, size.RowHeight);
  teams_->SetLetters(size.Growth, size.RowHeight);
  LimitTeams();
  layout()->activate();  // at once, so that the lists are not painted twice
}

void BoardPane::ShowTeamsBeside(bool beside) {
  if (beside == beside_) {
    return;
  }
  beside_ = beside;
  parts_->setDirection(beside ? QBoxLayout::LeftToRight : QBoxLayout::TopToBottom);
  parts_->setSpacing(beside ? Between : Below);
}

int BoardPane::RoomForRows(bool beside) const {
  const auto labelHeight = [this](int part) {
    QLayout& column = *parts_->itemAt(part)->layout();
    return column.itemAt(0)->sizeHint().height() + column.spacing();
  };
  const QMargins margins = parts_->contentsMargins();
  const int room =
      height() - margins.top() - margins.bottom() - labelHeight(0) - players_->HeightWithoutRows();
  return beside ? room : room - Below - labelHeight(1) - teams_->HeightWithoutRows();
}

int BoardPane::RowsToShow(bool beside) const {
  const int players = std::max(players_->model()->rowCount(), RowsInLargeLetters);
  return beside ? players : players + TeamCount;
}

double BoardPane::RoomAcross(bool beside, int rowHeight) const {
  const QMargins margins = parts_->contentsMargins();
  const bool scrolls = RoomForRows(beside) < rowHeight * RowsToShow(beside);
  return width() - margins.left() - margins.right() -
         (scrolls ? players_->verticalScrollBar()->sizeHint().width() : 0);
}

// Beside the players the teams get no more than they need where that would cost large letters or names.
void BoardPane::LimitTeams() {
  if (!beside_) {
    teams_->setMinimumWidth(0);
    teams_->setMaximumWidth(QWIDGETSIZE_MAX);
    return;
  }
  const int equal = teams_->FittingWidth(ScoreListView::Columns::Equal);
  const double players =
      players_->WidthAt(players_->Growth(), ScoreListView::Names::Whole, ScoreListView::Captions::Largest);
  const double room = RoomAcross(beside_, players_->verticalHeader()->defaultSectionSize());
  const bool isRoom = players + parts_->spacing() + equal <= room;
  teams_->setFixedWidth(isRoom ? equal : teams_->FittingWidth(ScoreListView::Columns::Own));
}

BoardPane::Size BoardPane::ChosenSize(bool beside, int percent) const {
  const int leastRow = players_->LeastRow();
  const double leastCapitals = players_->LeastCapitals();
  const double wish = percent / 100.0;
  const int ownRow = RowHeight(RoomForRows(beside), RowsToShow(beside), leastRow);
  const int row = std::max(static_cast<int>(std::lround(ownRow * wish)), leastRow);
  const int leastLetters = players_->LeastLetters();
  // Whole pixels here too.
  const auto inPixels = [leastLetters](double growth) {
    return std::round(growth * leastLetters) / leastLetters;
  };
  const double byHeight = inPixels(CapitalHeight(row, leastRow, leastCapitals) / leastCapitals);
  const double room = RoomAcross(beside, row);
  const auto neededFor = [this, beside](ScoreListView::Names names) {
    return [this, beside, names](double growth) {
      using Captions = ScoreListView::Captions;
      const double teams = teams_->WidthAt(growth, names, Captions::Largest);
      return players_->WidthAt(growth, names, Captions::Smallest) + (beside ? Between + teams : 0);
    };
  };
  // Names are cut before letters become hard to read, but not for the sake of still larger ones.
  const double readable = std::max(inPixels(ReadableCapitals / leastCapitals), 1.0);
  const double byWidth = std::max(
      GrowthThatFits(neededFor(ScoreListView::Names::Whole), room, byHeight / wish),
      GrowthThatFits(neededFor(ScoreListView::Names::Cut), room, std::min(byHeight / wish, readable)));
  const int letters = static_cast<int>(leastLetters * std::min(byHeight, byWidth * wish) + 0.01);
  return {std::max(static_cast<double>(letters) / leastLetters, 1.0), row};
}
