#pragma once

#include <cstddef>
#include <cstdint>
#include <functional>
#include <string>
#include <string_view>

#include "core/game/Game.h"

/// What others than the operator read: a second screen, printed lists, pages, exports. First and last names
/// never stand there.

/// Longest public name, in characters (code points).
inline constexpr std::size_t LongestPublicName = 30;

/// The nickname of the member with this `ContactID`; empty without one, or if there is no such member.
using NickNames = std::function<std::string(std::int32_t contactId)>;

/// The guest name that the player at record `index` has in this game; empty without one.
using GuestNames = std::function<std::string(int index)>;

/// `name` as a single short line: without control characters, marks that change the direction of writing,
/// bytes that are no UTF-8, marks without a letter, and blanks at the ends; at most LongestPublicName
/// characters, where a letter is dropped rather than parted from its marks. Empty if nothing visible is left.
std::string CleanName(std::string_view name);

/// The gun with the record at `index`: team, one blank, number: "Blue 7".
std::string GunName(const Game& game, int index);

/// The nickname of the player's member, else the guest name, else the gun. Without `guestNames` there are no
/// guests.
std::string PublicName(const Game& game, int index, const NickNames& nickNames,
                       const GuestNames& guestNames = {});
