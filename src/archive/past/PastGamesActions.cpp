// What the operator does with the games that the window lists.
#include <QPointer>
#include <QScopeGuard>
#include <algorithm>
#include <utility>

#include "archive/DeletedGames.h"
#include "archive/PackedBytes.h"
#include "archive/past/PastGames.h"
#include "core/gamefile/SuggestedName.h"
#include "core/text/Filled.h"
#include "platform/RuntimeError.h"
#include "ui/RowsAsText.h"
#include "ui/RunProgress.h"
#include "ui_PastGames.h"

namespace {

using GameNumbers = std::span<const std::int64_t>;

/// So many at once keep the window waiting for some tens of milliseconds where only their rows change.
std::size_t RowsAtOnce(GameNumbers games) {
  constexpr std::size_t most = 500;
  return std::min(most, games.size());
}

/// The same where the files of the games are read, and those of games that may be the same.
std::size_t FilesAtOnce(Sql& archive, GameNumbers games) {
  constexpr std::int64_t enoughBytes = 12 << 10;
  const std::size_t most = RowsAtOnce(games);
  std::size_t count = 0;
  for (std::int64_t bytes = 0; count < most && bytes < enoughBytes; ++count) {
    bytes += PackedBytesOf(archive, games[count]);
  }
  return count;
}

/// False if `goOn` ended it.
bool InPieces(GameNumbers games, const std::function<bool(double done)>& goOn,
              const std::function<std::size_t(GameNumbers games)>& atOnce,
              const std::function<void(const std::vector<std::int64_t>& some)>& act) {
  for (GameNumbers rest = games; !rest.empty();) {
    if (!goOn(1 - static_cast<double>(rest.size()) / static_cast<double>(games.size()))) {
      return false;
    }
    const GameNumbers some = rest.first(atOnce(rest));
    act({some.begin(), some.end()});
    rest = rest.subspan(some.size());
  }
  return true;
}

}  // namespace

void PastGames::OpenGame() {
  const PastGame* game = board_.Shown();
  if (game == nullptr || Listed().Which == ListedPast::Deleted) {
    return;
  }
  const StringTable& strings = parts_.Strings;
  if (const std::optional<OwnText> reason = parts_.Busy()) {
    Tell(Filled(strings.Text(OwnText::PastBusy), {strings.Text(*reason)}));
    return;
  }
  std::string bytes = parts_.Archive.Archive().FileOf(game->GameId, game->State);
  if (parts_.BoardIsUnsaved() &&
      parts_.Boxes.Show(
          Filled(strings.Text(OwnText::PastOpenQuestion), {ui_->BoardLabel->text().toStdString()}),
          DefaultBoxTitle, BoxIcon::Question, BoxButtons::OkCancel) != BoxAnswer::Ok) {
    return;
  }
  chosen_ = {game->GameId, game->State, std::move(bytes), game->Guests};
  accept();
}

void PastGames::SaveFile() {
  const PastGame& game = *board_.Shown();
  const StringTable& strings = parts_.Strings;
  const std::string bytes = parts_.Archive.Archive().FileOf(game.GameId, game.State);
  const std::optional<std::string> path = parts_.CommonDialog1.ShowSave(
      {.Filter = "XML Files & (*.xml) |*.xml", .Name = SuggestedGameName(game.Played, game.Mission)});
  if (!path) {
    return;
  }
  if (parts_.Disk.FileExists(*path) &&
      parts_.Boxes.Show(Filled(strings.Text(OwnText::CopyExists), {*path}),
                        strings.Text(OwnText::PastGamesTitle), BoxIcon::Question,
                        BoxButtons::YesNo) != BoxAnswer::Yes) {
    return;
  }
  parts_.Disk.Replace(*path, bytes);
  Tell(Filled(strings.Text(OwnText::GameExportSaved), {*path}));
}

void PastGames::ShowCharts() {
  parts_.ShowCharts(*board_.Shown());
}

void PastGames::Export() {
  parts_.Export(SelectedGames());
}

void PastGames::Delete() {
  const std::vector<std::int64_t> games = SelectedGames();
  if (games.empty() || Listed().Which == ListedPast::Deleted) {
    return;
  }
  const StringTable& strings = parts_.Strings;
  const std::string days = std::to_string(DaysOfDeletedGames);
  const ListedGame* only = games.size() == 1 ? games_.GameIn(games_.RowOf(games.front())) : nullptr;
  const std::string question =
      only != nullptr ? Filled(strings.Text(OwnText::PastDeleteOne),
                               {PastGameModel::TimeText(only->Played).toStdString(), days})
                      : Filled(strings.Text(OwnText::PastDeleteMany), {std::to_string(games.size()), days});
  if (parts_.Boxes.Show(question, strings.Text(OwnText::PastGamesTitle), BoxIcon::Question,
                        BoxButtons::OkCancel) != BoxAnswer::Ok) {
    return;
  }
  const std::string now = parts_.Time.Now();
  ChangeInSteps(
      games,
      {.Act =
           [&](const std::vector<std::int64_t>& some) { return parts_.Archive.Archive().Delete(some, now); },
       .AtOnce = RowsAtOnce},
      {OwnText::PastDeletedNow, OwnText::PastDeletedNow, OwnText::PastDeleteStopped});
}

void PastGames::BringBack() {
  ChangeInSteps(
      SelectedGames(),
      {.Act =
           [this](const std::vector<std::int64_t>& some) { return parts_.Archive.Archive().BringBack(some); },
       .AtOnce = [this](GameNumbers some) { return FilesAtOnce(parts_.Archive.Statements(), some); }},
      {OwnText::PastBroughtBack, OwnText::PastBroughtBackSome, OwnText::PastBringBackStopped});
}

void PastGames::ChangeInSteps(const std::vector<std::int64_t>& games, const Change& change,
                              const ChangeTexts& texts) {
  parts_.Archive.CheckSpace();
  const std::int64_t next = GameAfter(games_.Games(), games);
  int changed = 0;
  std::string failure;
  bool complete = false;
  try {
    RunInSteps(AreMany(games.size()) || change.AtOnce(games) < games.size(), [&](const Step& goOn) {
      complete = InPieces(games, goOn, change.AtOnce, [&](const auto& some) { changed += change.Act(some); });
    });
  } catch (const RuntimeError& error) {
    failure = error.what();
  }
  Refresh(next);
  if (!failure.empty()) {
    TellFailure(failure);
  } else {
    const int left = static_cast<int>(games.size()) - changed;
    const OwnText text = !complete ? texts.Stopped : left > 0 ? texts.DoneInPart : texts.Done;
    Tell(Filled(parts_.Strings.Text(text), {std::to_string(changed), std::to_string(left)}));
  }
  ui_->GameTable->setFocus();
}

void PastGames::Copy(const QAbstractItemView& list) {
  const int rows = list.model()->rowCount();
  bool copied = false;
  RunInSteps(AreMany(static_cast<std::size_t>(rows)),
             [&](const Step& goOn) { copied = CopyRowsInSteps(list, goOn); });
  if (!copied) {
    Tell(parts_.Strings.Text(OwnText::PastCopyStopped));
    return;
  }
  const QItemSelectionModel& chosen = *list.selectionModel();
  const auto count = chosen.hasSelection() ? chosen.selectedRows().size() : rows;
  Tell(Filled(parts_.Strings.Text(OwnText::PastCopied), {std::to_string(count)}));
}

bool PastGames::AreMany(std::size_t rows) {
  constexpr std::size_t few = 200;
  return rows > few;
}

void PastGames::RunInSteps(bool takesLong, const std::function<void(const Step& goOn)>& act) {
  if (!takesLong) {
    act([](double) { return true; });
    return;
  }
  const QPointer<QWidget> focused = focusWidget();
  std::vector<QWidget*> disabled;
  for (QWidget* control : findChildren<QWidget*>(QString(), Qt::FindDirectChildrenOnly)) {
    if (control->isEnabled() && control != ui_->Stop && control != ui_->Progress && control != ui_->Status) {
      disabled.push_back(control);
      control->setEnabled(false);
    }
  }
  ui_->Stop->show();
  const auto ended = qScopeGuard([&] {
    ui_->Stop->hide();
    for (QWidget* control : disabled) {
      control->setEnabled(true);
    }
    if (focused) {
      focused->setFocus();
    }
  });
  RunProgress progress(*ui_->Progress, *ui_->Stop, parts_.Events, stopped_);
  ui_->Stop->setFocus();
  act([&progress](double part) { return progress.GoOn(part); });
}

void PastGames::Import() {
  parts_.Archive.Close();
  parts_.Import();
  Refresh(CurrentGame());
}
