#pragma once

#include <string>

#include "core/text/StringTable.h"
#include "exports/GameWriter.h"

// The parts of a page that shows games: markup for an HtmlPage, with every text escaped. All of them show the
// standings and never the board's ranks.

/// What the parts of one game have in common.
struct GamePageParts {
  const ExportedGame& Game;
  const StringTable& Strings;
  PersonalData Personal = {};
  int Number = 1;  ///< of the game on its page; makes the links of each game its own
};

/// The teams that took part, highest soldiering first.
std::string TeamsHtml(const GamePageParts& parts);

/// All players in the order of their places, each with a link to its section.
std::string BoardHtml(const GamePageParts& parts);

/// A player's figures, whom the player hit and who hit the player. `standing` is one of the game's.
std::string PlayerHtml(const GamePageParts& parts, const Standing& standing);

/// All of these under the game's mission and date.
std::string GameHtml(const GamePageParts& parts);

/// A whole page of games.
class GamesPage : public GameWriter {
 public:
  /// `strings` must outlive the page.
  GamesPage(const PersonalData& personal, const StringTable& strings);

  void Add(const ExportedGame& game) override;
  void End() override;
  std::string Take() override;

 private:
  const PersonalData personal_;
  const StringTable& strings_;
  std::string html_;
  int number_ = 0;
};
