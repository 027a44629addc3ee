#pragma once

#include <string>
#include <string_view>
#include <vector>

#include "core/text/StringTable.h"
#include "web/PublicGame.h"
#include "web/PublicRanking.h"

/// A finished page: what a browser gets for a path.
struct Page {
  std::string Path;
  std::string Body;
};

/// Path under which a phone that does not know where to begin finds the newest board, in one language.
std::string FrontPath(Language language);

/// Board of the newest game, which a script follows; without a game, a page that says so. `newest` may be
/// null. `token` is the text of TokenPage at the same time. With a ranking there is a link to it.
Page FrontPage(const PublicGame* newest, std::string_view token, Language language, bool hasRanking = false);

/// Board, grid of guns, and a page for each gun of one game.
std::vector<Page> GamePages(const PublicGame& game, Language language);

/// Links to the boards of `games`, in their order, and to the ranking.
Page GamesPage(const std::vector<const PublicGame*>& games, Language language, bool hasRanking = false);

/// The ranking of `month`, "2026-11".
Page RankingPage(const std::string& month, const std::vector<RankedLine>& lines, Language language);

/// What a browser gets for a path that is not there: in both languages, `language` first.
Page MissingPage(Language language);

/// Differs whenever the newest board does: 16 letters or digits. The pages' script asks for it.
Page TokenPage(const PublicGame* newest);

/// Style and script.
std::vector<Page> FixedPages();
