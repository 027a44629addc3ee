#pragma once

#include "charts/ChartGame.h"
#include "core/game/HiddenNames.h"
#include "core/game/PublicName.h"

/// The player at record `index` as the charts of any game name them: the gun with the nickname, else the
/// guest name, behind it. A picture of them may leave the house: first and last names, and names in `hidden`,
/// do not belong there. Without `guestNames` there are no guests.
ChartPlayer PlayerOfChart(const Game& game, int index, const NickNames& nickNames,
                          const GuestNames& guestNames, const HiddenNames& hidden);
