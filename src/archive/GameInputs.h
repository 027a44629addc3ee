#pragma once

#include <string>

#include "core/game/Game.h"

/// What a game is made of, without anything that is calculated from it: mission, date, mission results, and
/// of each active player the gun's figures, hits, member, bonus and whether it is committed. Equal for a game
/// and for the same game read back from its file, whatever the factors and the order of the board. So two
/// games with equal inputs are one game.
std::string GameInputs(const Game& game, const std::string& missionName);

/// The same of a game whoever its players are, and whether or not they are committed: equal for a game and
/// for the same game once members were found, cut from it or committed.
std::string InputsOfAnybody(Game game, const std::string& missionName);

/// A short text for GameInputs, different for different games but for a chance that nobody will meet.
std::string GameInputsHash(const std::string& inputs);
