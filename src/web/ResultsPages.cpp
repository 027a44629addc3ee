#include "web/ResultsPages.h"

#include <algorithm>
#include <iterator>
#include <utility>

namespace {

constexpr Language PageLanguages[] = {Language::English, Language::SimplifiedChinese};

}  // namespace

ResultsPages::ResultsPages(Language language, const Limits& limits) : language_(language), limits_(limits) {
  for (Page& page : FixedPages()) {
    PutPage(std::move(page));
  }
  PutPage(MissingPage(language_));
  RenderCommon();
}

void ResultsPages::Put(const PublicGame& game, std::chrono::microseconds now) {
  const auto at =
      std::ranges::lower_bound(games_, game.Number, {}, [](const Entry& entry) { return entry.Game.Number; });
  if (at != games_.end() && at->Game.Number == game.Number) {
    at->Game = game;
    Render(*at);
  } else {
    Render(*games_.insert(at, {.Game = game, .Since = now, .Paths = {}, .Bytes = 0}));
  }
  DropBeyondLimits();
  RenderCommon();
}

void ResultsPages::Prune(std::chrono::microseconds now) {
  const std::size_t before = games_.size();
  for (std::size_t at = 0; at < games_.size();) {
    const auto entry = games_.begin() + static_cast<std::ptrdiff_t>(at);
    if (now - entry->Since >= limits_.Age) {
      Remove(entry);
    } else {
      ++at;
    }
  }
  if (games_.size() < before) {
    RenderCommon();
  }
}

void ResultsPages::SetGames(std::size_t most) {
  limits_.Games = most;
  DropBeyondLimits();
  RenderCommon();
}

void ResultsPages::SetRanking(const std::optional<MonthRanking>& ranking) {
  for (const Language language : PageLanguages) {
    if (ranking) {
      PutPage(RankingPage(ranking->Month, ranking->Lines, language));
    } else if (ranking_) {
      RemovePage(RankingPage({}, {}, language).Path);
    }
  }
  ranking_ = ranking;
  RenderCommon();
}

std::vector<PageFrame> ResultsPages::TakeChanges() {
  std::vector<PageFrame> frames;
  for (const auto& [path, order] : changes_) {
    frames.push_back(
        {.Order = order, .Path = path, .Body = order == PageOrder::Put ? pages_.at(path) : std::string()});
  }
  changes_.clear();
  if (!frames.empty()) {
    frames.emplace_back();
  }
  return frames;
}

std::vector<PageFrame> ResultsPages::TakeAll() {
  changes_.clear();
  std::vector<PageFrame> frames;
  frames.reserve(pages_.size() + 1);
  for (const auto& [path, body] : pages_) {
    frames.push_back({.Order = PageOrder::Put, .Path = path, .Body = body});
  }
  frames.emplace_back();
  return frames;
}

void ResultsPages::PutPage(Page page) {
  std::string& body = pages_[page.Path];
  if (body != page.Body) {
    body = std::move(page.Body);
    changes_[page.Path] = PageOrder::Put;
  }
}

void ResultsPages::RemovePage(const std::string& path) {
  if (pages_.erase(path) > 0) {
    changes_[path] = PageOrder::Remove;
  }
}

void ResultsPages::Render(Entry& entry) {
  const std::vector<std::string> before = std::exchange(entry.Paths, {});
  entry.Bytes = 0;
  for (const Language language : PageLanguages) {
    for (Page& page : GamePages(entry.Game, language)) {
      entry.Paths.push_back(page.Path);
      entry.Bytes += page.Body.size();
      PutPage(std::move(page));
    }
  }
  for (const std::string& path : before) {
    if (std::ranges::find(entry.Paths, path) == entry.Paths.end()) {
      RemovePage(path);
    }
  }
}

void ResultsPages::Remove(std::vector<Entry>::iterator entry) {
  for (const std::string& path : entry->Paths) {
    RemovePage(path);
  }
  games_.erase(entry);
}

void ResultsPages::DropBeyondLimits() {
  const auto bytes = [this] {
    std::size_t sum = 0;
    for (const Entry& entry : games_) {
      sum += entry.Bytes;
    }
    return sum;
  };
  while (games_.size() > 1 && (games_.size() > limits_.Games || bytes() > limits_.Bytes)) {
    Remove(games_.begin());
  }
}

void ResultsPages::RenderCommon() {
  const PublicGame* newest = games_.empty() ? nullptr : &games_.back().Game;
  std::vector<const PublicGame*> newestFirst;
  std::transform(games_.rbegin(), games_.rend(), std::back_inserter(newestFirst),
                 [](const Entry& entry) { return &entry.Game; });
  Page token = TokenPage(newest);
  for (const Language language : PageLanguages) {
    Page front = FrontPage(newest, token.Body, language, ranking_.has_value());
    if (language == language_) {
      PutPage({.Path = "/", .Body = front.Body});
    }
    PutPage(std::move(front));
    PutPage(GamesPage(newestFirst, language, ranking_.has_value()));
  }
  PutPage(std::move(token));
}
