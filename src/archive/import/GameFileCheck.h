#pragma once

#include <cstddef>
#include <functional>
#include <optional>
#include <string>

#include "core/game/Game.h"
#include "core/text/StringTable.h"

/// Why a file is not imported, in the order of the operator's texts.
enum class GameFileFault {
  Unreadable,      ///< What: the disk's own words
  TooLarge,        ///< What: most megabytes
  NotXml,          ///< damaged, cut off, or something else altogether
  OtherKind,       ///< XML, but no game; What: its root element
  NoPlayers,       ///< nobody took part
  NoNumber,        ///< What: the element, with its text
  NumberTooLarge,  ///< likewise
  NoSuchPlace,     ///< of a player or a team; What: likewise
  SumTooLarge,     ///< of a team's scores or of a player's damage
};

struct GameFileTrouble {
  GameFileFault Fault = GameFileFault::NotXml;
  std::size_t Line = 0;  ///< counted from 1; 0 where no line can be told
  std::string What = {};
};

/// A game as a file has it, with what follows from its figures.
struct GameInFile {
  ::Game Game;
  std::string Mission;
};

/// Called now and then in the middle of long work; must not throw.
using Breath = std::function<void()>;

/// Reads the game file in `bytes` into `game`. Returns what is wrong with it, or nothing if it is a game.
std::optional<GameFileTrouble> ReadCheckedGame(const std::string& bytes, const StringTable& strings,
                                               GameInFile& game, const Breath& breathe);

/// The operator's text for it, without file and line.
std::string TextOf(const GameFileTrouble& trouble, const StringTable& strings);
