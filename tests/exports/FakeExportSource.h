#pragma once

#include <map>
#include <optional>
#include <set>
#include <string>
#include <utility>
#include <vector>

#include "exports/ExportSource.h"
#include "platform/RuntimeError.h"
#include "tests/exports/SampleGame.h"

/// Past games that are all the sample, each with a mission of its own: "Game 7".
class FakeExportSource : public ExportSource {
 public:
  explicit FakeExportSource(Language language = Language::English) : sample_(language) {}

  /// The games of every period.
  std::vector<std::int64_t> Games;
  /// Games whose files are damaged.
  std::set<std::int64_t> Damaged;
  /// What the next game's reading throws.
  std::optional<RuntimeError> Failure;

  /// Periods and games that were asked for.
  std::vector<std::pair<std::string, std::string>> Periods;
  std::vector<std::int64_t> Asked;

  std::vector<std::int64_t> Of(const std::string& firstDay, const std::string& lastDay) override {
    Periods.emplace_back(firstDay, lastDay);
    return Games;
  }

  void Read(std::int64_t gameId, const std::function<void(const ExportedGame&)>& take) override {
    Asked.push_back(gameId);
    Fail();
    if (Damaged.contains(gameId)) {
      throw RuntimeError(Fault::InvalidFileFormat);
    }
    sample_.Mission = "Game " + std::to_string(gameId);
    take(sample_.Exported());
  }

  void ReadFigures(const std::vector<std::int64_t>& games, bool fullNames,
                   const std::function<void(const PlayerFigures&)>& take) override {
    for (const std::int64_t gameId : games) {
      Read(gameId, [&](const ExportedGame& game) {
        for (const Standing& standing : game.Standings) {
          take(FiguresOf(game, standing, gameId, fullNames));
        }
      });
    }
  }

 private:
  void Fail() const {
    if (Failure) {
      throw RuntimeError(*Failure);
    }
  }

  SampleGame sample_;
};
