#include "board/PlayerDetails.h"

#include <utility>

#include "board/HitBars.h"
#include "core/game/PlayerId.h"
#include "core/text/NumberForms.h"
#include "ui/TeamColours.h"
#include "ui_PlayerDetails.h"

PlayerDetails::PlayerDetails(int playerIndex, const Game& game, MemberLookup& members, QWidget* parent)
    : QDialog(parent), ui_(std::make_unique<Ui::PlayerDetails>()) {
  ui_->setupUi(this);
  const Player& player = game.Players(playerIndex);
  ui_->PlayerName->setText(QString::fromStdString(game.DisplayName(playerIndex)));
  ShowFigures(player);
  ShowHits(HitsGivenBy(playerIndex, game), game, members, *ui_->WhoYouHit, *ui_->InflictedBars);
  ShowHits(HitsTakenBy(playerIndex, game), game, members, *ui_->WhoHitYou, *ui_->TakenBars);
  for (const std::string& line : SpecialDamageOf(player)) {
    ui_->WhoHitYou->addItem(QString::fromStdString(line));
  }
}

PlayerDetails::~PlayerDetails() = default;

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

void PlayerDetails::ShowHits(const std::vector<Hit>& hits, const Game& game, MemberLookup& members,
                             QListWidget& list, HitBars& bars) {
  std::vector<HitBars::Bar> shown;
  for (const Hit& hit : hits) {
    const std::string name = game.DisplayName(hit.Index);
    list.addItem(QString::fromStdString(HitText(name, hit, game, members, false)));
    shown.push_back(
        {QString::fromStdString(name), hit.Amount, TeamColour(TeamFromId(IdFromIndex(hit.Index)))});
  }
  bars.SetBars(std::move(shown));
}
