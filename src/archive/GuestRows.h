#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <vector>

#include "core/game/GuestList.h"
#include "platform/Database.h"

// Names of guests in the rows of games. An archive that was made before there were any has no column for them
// until the first one is written. All throw RuntimeError as Sql does.

/// True if the archive has the column.
bool HasGuestNames(Database& archive);

/// Those of a game, by the record of the gun.
GuestList::Names GuestNamesOf(Database& archive, std::int64_t gameId);

/// Takes the names off these rows of a game, by the records of their guns.
void ForgetGuestNames(Database& archive, std::int64_t gameId, const std::vector<std::int64_t>& players);

/// The guest names of the game on the board, as they go into its rows. They are no input of the game: what
/// changes is written, and everything else about the game stays.
class KeptGuests {
 public:
  /// `guests` must outlive this object; null where nobody enters names.
  explicit KeptGuests(const GuestList* guests) : guests_(guests) {}

  /// Another game comes onto the board.
  void Forget() { game_.reset(); }

  /// True if the names are not those that were kept last with this game.
  bool HaveChanged(std::int64_t gameId) const;

  /// Writes what has changed since then, clean. Names of a game that nothing was kept of on this board stay
  /// where the operator enters none. Throws RuntimeError as Sql does; nothing is changed then.
  void Keep(Database& archive, std::int64_t gameId);

 private:
  GuestList::Names Before(std::int64_t gameId) const { return game_ == gameId ? kept_ : GuestList::Names(); }

  const GuestList* guests_;
  std::optional<std::int64_t> game_;
  GuestList::Names kept_;  ///< with `game_`, as they were entered
};
