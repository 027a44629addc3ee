#pragma once

#include <chrono>
#include <cstddef>
#include <cstdint>
#include <functional>
#include <map>
#include <string>
#include <vector>

#include "core/game/HiddenNames.h"
#include "web/PublicGame.h"

/// A game of this evening, with what its public names are made of.
struct EveningGame {
  PublicGame Figures;                       ///< without names
  std::vector<NameHolder> Holders = {};     ///< of its players, in their order
  std::map<int, std::uint64_t> Marks = {};  ///< what each gun noted, by its record
  std::chrono::microseconds Since{};        ///< when it was played
  bool IsPublic = false;                    ///< it has appeared on the pages
};

/// The game as the pages may show it. `nameShown` gives the name for a holder, or an empty text.
PublicGame PublicGameOf(const EveningGame& game,
                        const std::function<std::string(const NameHolder&)>& nameShown);

/// The last games of this evening, numbered as they came. The game on the board is one of them from its first
/// figures until the board is cleared. One whose guns noted the same as before, pulled again onto an empty
/// board, is the same game, also if some guns were or are missing.
class EveningGames {
 public:
  static constexpr std::size_t Most = 30;
  static constexpr std::chrono::hours Age{12};

  /// A game with its scores.
  struct Scored {
    const ::Game& Game;
    std::string Time;  ///< when it was played, as the pages show it
    std::chrono::microseconds Played{};
    NickNames OfMembers;
    GuestNames OfGuests;
  };

  /// Takes the game in, or as it is now. Returns true if there is something new in it; a game without players
  /// is left alone.
  bool Take(const Scored& scored);

  /// Takes a game in that was kept before, and returns its number; 0 for one without players. To be called in
  /// the order in which they were played, before the first call of Take.
  int TakeEarlier(const Scored& scored);

  /// The board was cleared: what comes next is another game.
  void ForgetBoard() { onBoard_ = 0; }

  /// Number of the game on the board; 0 if it has none.
  int OnBoard() const { return onBoard_; }

  /// Members may be called otherwise than before, or be gone.
  void NameAnew(const NickNames& ofMembers);

  /// Drops what is too old at time `now`, and the first ones of too many.
  void Prune(std::chrono::microseconds now);

  /// By number.
  std::map<int, EveningGame>& All() { return games_; }

 private:
  static EveningGame GameOf(const Scored& scored);

  /// The number of the game whose guns noted this; 0 if it is a new one.
  int NumberOf(const std::map<int, std::uint64_t>& marks) const;

  std::map<int, EveningGame> games_;
  int onBoard_ = 0;
  int last_ = 0;  ///< the highest number so far
};
