#pragma once

#include <chrono>
#include <cstddef>
#include <map>
#include <optional>
#include <string>
#include <vector>

#include "core/text/StringTable.h"
#include "web/PageStream.h"
#include "web/Pages.h"
#include "web/PublicGame.h"

/// The pages of an evening's last games, and what changed in them since somebody last looked.
class ResultsPages {
 public:
  struct Limits {
    std::size_t Games = 20;
    std::chrono::hours Age{12};
    std::size_t Bytes = MostPageBytes / 2;  ///< of all pages; the newest game is always shown
  };

  /// `language` is that of "/", for those who choose none.
  explicit ResultsPages(Language language) : ResultsPages(language, {}) {}
  ResultsPages(Language language, const Limits& limits);

  /// Adds a game at time `now`, or puts it in the place of the game with its number, whose age it keeps.
  void Put(const PublicGame& game, std::chrono::microseconds now);

  /// Drops the games that have become too old.
  void Prune(std::chrono::microseconds now);

  /// From now on so many games at most are shown; those that are dropped do not come back by themselves.
  void SetGames(std::size_t most);

  /// Shows the ranking of a month, or none.
  struct MonthRanking {
    std::string Month;  ///< "2026-11"
    std::vector<RankedLine> Lines;
  };
  void SetRanking(const std::optional<MonthRanking>& ranking);

  /// Orders that make the served pages those of now, if they were those of the last call; empty if nothing
  /// has changed.
  std::vector<PageFrame> TakeChanges();

  /// Orders that make all pages for a reader without any. The next TakeChanges begins from these.
  std::vector<PageFrame> TakeAll();

  /// By path.
  const std::map<std::string, std::string>& Pages() const { return pages_; }

 private:
  struct Entry {
    PublicGame Game;
    std::chrono::microseconds Since{};
    std::vector<std::string> Paths;  ///< of its pages
    std::size_t Bytes = 0;
  };

  void PutPage(Page page);
  void RemovePage(const std::string& path);
  void Render(Entry& entry);
  void Remove(std::vector<Entry>::iterator entry);
  void DropBeyondLimits();
  void RenderCommon();

  Language language_;
  Limits limits_;
  std::vector<Entry> games_;  ///< by number
  std::optional<MonthRanking> ranking_;
  std::map<std::string, std::string> pages_;
  std::map<std::string, PageOrder> changes_;  ///< by path
};
