#pragma once

#include <cstdint>

#include "core/game/Game.h"

// Short marks of figures, different for different figures but for a chance that nobody will meet.

/// Of a player's figures as the gun gave them.
std::uint64_t RawDigest(const Player& player);

/// Of what the calculation gave the active players.
std::uint64_t FiguresDigest(const Game& game);
