#pragma once

#include <functional>

#include "demo/pictures/Studio.h"

/// Serial ports of the settings that the simulated devices are on.
enum class VenuePort { BaseUnit = 1, Reader = 2, Radio = 3, Box = 4, Device = 5 };

/// Enters the port in the settings. `picture` is taken of them before they close, unless null.
void ChoosePort(Studio& studio, VenuePort port, const char* picture = nullptr);

/// Plays an evening's game: the windows around the board, members and missions.
void TakeDesk(Studio& studio);

/// The windows that service the equipment. `tell` gives the simulated venue a command.
void TakeEquipment(Studio& studio, const std::function<void(const QString& command)>& tell);
