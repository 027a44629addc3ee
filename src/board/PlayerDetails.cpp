#include "board/PlayerDetails.h"

#include <QShortcut>
#include <utility>

#include "charts/HitBars.h"
#include "core/game/PlayerId.h"
#include "core/text/NumberForms.h"
#include "ui/Announce.h"
#include "ui/TeamColours.h"
#include "ui/Text.h"
#include "ui_PlayerDetails.h"

PlayerDetails::PlayerDetails(int playerIndex, const Parts& parts, QWidget* parent)
    : QDialog(parent), parts_(parts), ui_(std::make_unique<Ui::PlayerDetails>()) {
  ui_->setupUi(this);
  ui_->PlayerName->setToolTip(Text(parts.Strings, OwnText::WalkTip));
  for (const auto& [key, rows] : {std::pair{Qt::Key_PageUp, -1}, {Qt::Key_PageDown, 1}}) {
    auto* shortcut = new QShortcut(key, this);  // before the lists, which would scroll
    connect(shortcut, &QShortcut::activated, this, [this, rows = rows] { Walk(rows); });
  }
  ShowPlayer(playerIndex);
}

PlayerDetails::~PlayerDetails() = default;

void PlayerDetails::ShowPlayer(int playerIndex) {
  playerIndex_ = playerIndex;
  const Game& game = parts_.Game;
  ui_->PlayerName->setText(QString::fromStdString(
      PlayerText(playerIndex, parts_.Players, game, BoardTexts(game, parts_.Strings))));
  ShowFigures(game.Players(playerIndex));
  ShowHits(HitsGivenBy(playerIndex, game), *ui_->WhoYouHit, *ui_->InflictedBars);
  ShowHits(HitsTakenBy(playerIndex, game), *ui_->WhoHitYou, *ui_->TakenBars);
  for (const std::string& line : SpecialDamageOf(game.Players(playerIndex))) {
    ui_->WhoHitYou->addItem(QString::fromStdString(line));
  }
}

void PlayerDetails::Walk(int rows) {
  const std::optional<int> place = parts_.Players.PlaceOf(playerIndex_);
  const int next = place.value_or(0) + rows;
  if (!place || next < 0 || next >= parts_.Players.RowCount()) {
    return;
  }
  ShowPlayer(parts_.Players.RowAt(next).Index);
  Announce(*ui_->PlayerName);
  emit PlayerShown(playerIndex_);
}

void PlayerDetails::ShowFigures(const Player& player) {
  const std::pair<QLabel*, std::string> figures[] = {
      {ui_->SoldieringDisplay, Str(player.Soldiering)},
      {ui_->AccuracyDisplay, player.Accuracy == 0 ? "N/A" : FormatPercent(player.Accuracy)},
      {ui_->PowerCheatDisplay, Str(std::int32_t{player.PowerCheatFlag})},
      {ui_->AdminKillDisplay, Str(player.AdminKillCount)},
      {ui_->CommitedDisplay, player.Committed ? "Yes" : "No"},
      {ui_->MemberIndexDisplay, Str(player.MemberIndex)},
      {ui_->MemberIDDisplay, player.DallasID},
      {ui_->SecondaryDamageDisplay, Str(player.SecondaryDamage)},
      {ui_->PrimaryDamageDisplay, Str(player.PrimaryDamage)},
      {ui_->DeathDisplay, Str(player.DeathCount)},
      {ui_->RunTimeDisplay, std::to_string(player.RunCounter)},
      {ui_->RespawnDisplay, Str(player.RespawnCount)},
      {ui_->AmmoAddDisplay, Str(player.AmmoAddCount)},
      {ui_->HealDisplay, Str(player.HealCount)},
      {ui_->DamageDisplay, Str(player.TotalDamage)},
      {ui_->TotalShotsDisplay, Str(player.ShotCount)},
      {ui_->RemAmmoDisplay, Str(player.RemainingAmmo)},
      {ui_->RemClipsDisplay, std::to_string(player.RemainingClips)},
      {ui_->RemHealthDisplay, std::to_string(player.RemainingHealth)},
  };
  for (const auto& [display, text] : figures) {
    display->setText(QString::fromStdString(text));
  }
}

void PlayerDetails::ShowHits(const std::vector<Hit>& hits, QListWidget& list, HitBars& bars) const {
  const Game& game = parts_.Game;
  list.clear();
  std::vector<HitBars::Bar> shown;
  for (const Hit& hit : hits) {
    const std::string name = game.DisplayName(hit.Index);
    list.addItem(QString::fromStdString(HitText(name, hit, game, parts_.Members, false)));
    shown.push_back(
        {QString::fromStdString(name), hit.Amount, TeamColour(TeamFromId(IdFromIndex(hit.Index)))});
  }
  bars.SetBars(std::move(shown));
}
