// What the operator does with the games that the window lists.
#include <utility>

#include "archive/DeletedGames.h"
#include "archive/past/PastGames.h"
#include "core/gamefile/SuggestedName.h"
#include "core/text/Filled.h"
#include "ui_PastGames.h"

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
  chosen_ = {game->GameId, game->State, std::move(bytes)};
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
  const std::int64_t next = GameAfter(games_.Games(), games);
  parts_.Archive.CheckSpace();
  const int deleted = parts_.Archive.Archive().Delete(games, parts_.Time.Now());
  Refresh(next);
  Tell(Filled(strings.Text(OwnText::PastDeletedNow), {std::to_string(deleted)}));
  ui_->GameTable->setFocus();
}

void PastGames::BringBack() {
  const std::vector<std::int64_t> games = SelectedGames();
  const std::int64_t next = GameAfter(games_.Games(), games);
  parts_.Archive.CheckSpace();
  const int back = parts_.Archive.Archive().BringBack(games);
  const int left = static_cast<int>(games.size()) - back;
  Refresh(next);
  Tell(Filled(parts_.Strings.Text(left > 0 ? OwnText::PastBroughtBackSome : OwnText::PastBroughtBack),
              {std::to_string(back), std::to_string(left)}));
  ui_->GameTable->setFocus();
}

void PastGames::Import() {
  parts_.Archive.Close();
  parts_.Import();
  Refresh(CurrentGame());
}
