#include "web/PublicGame.h"

#include <algorithm>

#include "core/game/HitLines.h"
#include "core/game/PlayerId.h"
#include "core/game/Standings.h"

namespace {

std::string NameShown(const Game& game, const Standing& standing, const ShownNames& names) {
  const bool hidden = names.Hidden && names.Hidden(standing.Index);
  const bool isGun = standing.PublicName == GunName(game, standing.Index);
  return names.Shown && !hidden && !isGun ? standing.PublicName : std::string();
}

std::vector<PublicHit> MostFirst(const std::vector<Hit>& hits) {
  std::vector<PublicHit> sorted;
  sorted.reserve(hits.size());
  for (const Hit& hit : hits) {
    sorted.push_back({.Gun = hit.Index, .Amount = hit.Amount});
  }
  std::ranges::stable_sort(sorted, std::greater(), &PublicHit::Amount);
  return sorted;
}

}  // namespace

PublicGame PublicGameOf(const Game& game, int number, std::string_view time, const ShownNames& names) {
  PublicGame shown{.Number = number, .Time = CleanName(time)};
  const NickNames ofMembers =
      names.Shown && names.OfMembers ? names.OfMembers : [](std::int32_t) { return std::string(); };
  const GuestNames ofGuests = names.Shown ? names.OfGuests : GuestNames();
  for (const Standing& standing : Standings(game, ofMembers, ofGuests)) {
    shown.Players.push_back({.Place = standing.Place,
                             .Gun = standing.Index,
                             .Name = NameShown(game, standing, names),
                             .Soldiering = standing.Soldiering,
                             .Accuracy = standing.Accuracy,
                             .DamageDealt = standing.DamageDealt,
                             .DamageTaken = standing.DamageTaken,
                             .Shots = standing.Shots,
                             .Wia = standing.Wia,
                             .Kia = standing.Kia,
                             .AmmoAdds = standing.AmmoAdds,
                             .HitsGiven = MostFirst(HitsGivenBy(standing.Index, game)),
                             .HitsTaken = MostFirst(HitsTakenBy(standing.Index, game))});
    shown.TeamTotals.at(static_cast<std::size_t>(standing.Team - 1)) += standing.Soldiering;
  }
  return shown;
}

int TeamOfGun(int gun) {
  return TeamFromId(IdFromIndex(gun));
}
