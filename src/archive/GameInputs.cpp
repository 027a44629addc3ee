#include "archive/GameInputs.h"

#include "archive/Digests.h"
#include "core/game/DallasId.h"
#include "core/text/NumberForms.h"

namespace {

/// Every text with its length before it, so that no two different lists give the same bytes.
class InputList {
 public:
  std::string Bytes;

  void Add(std::int32_t number) { Bytes.append(std::to_string(number)).append(";"); }
  void Add(const std::string& text) { Bytes.append(std::to_string(text.size())).append(":").append(text); }
};

void AddInputsOf(const Player& player, InputList& list) {
  for (const std::int32_t figure :
       {player.ShotCount, player.HealCount, player.AmmoAddCount, player.AdminKillCount, player.RespawnCount,
        player.RemainingHealth, player.RemainingClips, player.RemainingAmmo, player.DeathCount,
        player.SecondaryDamage, player.PrimaryDamage, player.RunCounter, player.MemberIndex,
        std::int32_t{player.Committed}, player.BonusPoints, player.ExplosiveDamage, player.RadiationDamage,
        player.StunCount, std::int32_t{player.PowerCheatFlag}}) {
    list.Add(figure);
  }
  list.Add(player.DallasID);
  // Otherwise it is calculated.
  list.Add(player.PrimaryDamage == 0 ? Str(player.Accuracy) : std::string());
  for (int shooter = 1; shooter <= PlayerCount; ++shooter) {
    // Game files do not hold any others.
    if (const std::int32_t amount = player.HitByPlayer(shooter); amount > 0) {
      list.Add(shooter);
      list.Add(amount);
    }
  }
}

}  // namespace

std::string GameInputs(const Game& game, const std::string& missionName) {
  InputList list;
  list.Add(missionName);
  list.Add(game.GameDate);
  for (const ObjectiveTeam& objective : game.ObjectiveTeams) {
    list.Add(objective.Name);
    list.Add(objective.PrimaryAchieved ? 1 : 0);
    list.Add(objective.SecondaryAchieved ? 1 : 0);
  }
  for (int index = 1; index <= PlayerCount; ++index) {
    if (game.Players(index).Active) {
      list.Add(-index);  // no hit begins with a negative number
      AddInputsOf(game.Players(index), list);
    }
  }
  return std::move(list.Bytes);
}

std::string InputsOfAnybody(Game game, const std::string& missionName) {
  for (Player& player : game.Players) {
    player.MemberIndex = 0;
    player.DallasID = NoDallasId;
    player.Committed = false;
  }
  return GameInputs(game, missionName);
}

std::string GameInputsHash(const std::string& inputs) {
  return Sha256(inputs);
}
