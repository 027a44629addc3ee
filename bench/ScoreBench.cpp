#include <benchmark/benchmark.h>

#include <charconv>

#include "bench/FullGame.h"
#include "bench/Goals.h"

namespace {

constexpr int ManyMembers = 100'000;

/// The minimum work of any calculation: one pass over the hits, and the board's numbers as text.
void Limit(benchmark::State& state) {
  FullGame full(0);
  while (state.KeepRunning()) {
    std::int64_t sum = 0;
    for (const Player& player : full.game.Players) {
      for (const std::int32_t hit : player.HitByPlayer) {
        sum += hit;
      }
    }
    benchmark::DoNotOptimize(sum);
    for (int row = 0; row < PlayerCount; ++row) {
      for (int column = 0; column < BoardColumnCount; ++column) {
        char text[16];
        const auto end =
            std::to_chars(text, text + sizeof text, full.game.Players(row + 1).HitByPlayer(column + 1) * 97);
        benchmark::DoNotOptimize(end.ptr);
        benchmark::DoNotOptimize(text);
      }
    }
  }
}
BENCHMARK(Limit);

void Score(benchmark::State& state, int members, int mode, bool byButton) {
  FullGame full(members);
  full.Missions->Select(mode);
  while (state.KeepRunning()) {
    if (byButton) {
      full.Unassign();
    }
    full.CalculateScores();
    benchmark::DoNotOptimize(full.ShowLists());
  }
}
BENCHMARK_CAPTURE(Score, plain, 0, MissionList::None, false);
BENCHMARK_CAPTURE(Score, mission, 0, 2, false);
BENCHMARK_CAPTURE(Score, members, ManyMembers, MissionList::None, false);
BENCHMARK_CAPTURE(Score, buttons, ManyMembers, MissionList::None, true);

}  // namespace

int main(int argc, char** argv) {
  auto times = MedianTimes(argc, argv);
  const auto report = [&times](const char* name, const char* what, const char* limit, double goal) {
    return ReportGoal(name, times[what] / times[limit], goal, TimesText(times[what], times[limit]));
  };
  bool met = report("scores of the fullest game / one pass and texts", "Score/plain", "Limit", 5);
  met &= report("  the same in a mission", "Score/mission", "Limit", 5);
  met &= report("with 100,000 members / without", "Score/members", "Score/plain", 3);
  met &= report("  looked up by their buttons / without", "Score/buttons", "Score/plain", 3);
  return met ? 0 : 1;
}
