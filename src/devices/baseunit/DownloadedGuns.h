#pragma once

#include <array>
#include <cstdint>
#include <map>
#include <set>

#include "core/game/ScoreFrame.h"

/// Takes the frames of downloads into the game. Downloads add up, but a gun that came in with one that did
/// not end well is not counted twice: when it comes again with the next one, what it gave before is taken
/// back first.
class DownloadedGuns {
 public:
  /// `game` must outlive this object.
  explicit DownloadedGuns(Game& game) : game_(game) {}

  /// A download begins.
  void Begin() { current_.clear(); }

  /// As ::AnalyseData.
  void AnalyseData(ReceiveBuffer& buffer, const Clock& clock);

  /// The download has ended with every frame: the guns so far stay counted, whatever comes next.
  void Settle();

  /// The scores of the gun with this record are about to be added to the game by another road.
  void ComesOtherwise(int index);

  /// The game was emptied.
  void Forget();

  /// Records of the guns whose frames were added to what the game held of them already.
  const std::set<int>& CountedTwice() const { return countedTwice_; }

 private:
  static constexpr std::size_t CounterCount = 9;

  /// What an unsettled download has added for one gun.
  struct Amounts {
    std::array<std::int32_t, CounterCount> Counters{};
    std::map<int, std::int32_t> Hits;  ///< by record index of the shooter
    bool First = false;                ///< the game held nothing of the gun before
  };

  static std::array<std::int32_t*, CounterCount> CountersOf(Player& player);
  static void AddDifference(Amounts& amounts, Player& before, Player& after);
  static void TakeBack(const Amounts& amounts, Player& player);

  Game& game_;
  std::map<int, Amounts> unsettled_;  ///< by record index of the gun
  std::set<int> current_;             ///< guns that came in with the current download
  std::set<int> countedTwice_;
};
