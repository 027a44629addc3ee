#include <QApplication>
#include <ctime>
#include <vector>

#include "bench/FullGame.h"
#include "bench/Goals.h"
#include "charts/HitMap.h"
#include "charts/ScoreParts.h"
#include "ui/Look.h"

namespace {

constexpr int Runs = 41;

/// Of this process, so that nothing else on the machine counts.
double ChartMicroseconds() {
  return 1e6 * static_cast<double>(std::clock()) / CLOCKS_PER_SEC;
}

ChartGame ChartOfAll(const Game& game) {
  ChartGame chart{.Game = game, .Players = {}, .Factors = {}};
  for (int index = 1; index <= PlayerCount; ++index) {
    chart.Players.push_back({index, game.DisplayName(index)});
  }
  return chart;
}

/// Time of one repaint of the whole map; of one after its figures or its size changed, if `anew`.
double RepaintTime(HitMap& map, const HitMatrix& matrix, bool anew) {
  std::vector<double> times;
  for (int run = 0; run < Runs; ++run) {
    if (anew) {
      map.SetMatrix(matrix);
    }
    const double start = ChartMicroseconds();
    map.repaint();
    QApplication::processEvents();
    times.push_back(ChartMicroseconds() - start);
  }
  return Median(times);
}

bool ReportRepaint(const char* name, const HitMatrix& matrix, const StringTable& strings, QSize size,
                   bool anew) {
  constexpr double limit = 16'000;
  HitMap map;
  map.SetUp(strings);
  map.SetMatrix(matrix);
  map.resize(size);
  map.show();
  QApplication::processEvents();
  const double time = RepaintTime(map, matrix, anew);
  return ReportGoal(name, time / limit, 1, TimesText(time, limit));
}

}  // namespace

/// bench-charts: the charts of the fullest game.
int main(int argc, char** argv) {
  QApplication application(argc, argv);
  PrepareLook();
  const StringTable strings(Language::English);
  Game game(strings);
  FillCompletely(game);
  const HitMatrix matrix(ChartOfAll(game));
  constexpr QSize window(1000, 900);
  constexpr QSize large(2400, 2000);  // of a 4K screen, beside its table
  bool met = ReportRepaint("heat map of 224 x 224, repainted / 16 ms", matrix, strings, window, false);
  met &= ReportRepaint("heat map of 224 x 224, drawn anew / 16 ms", matrix, strings, window, true);
  met &= ReportRepaint("heat map of 224 x 224 on 4K, drawn anew / 16 ms", matrix, strings, large, true);
  return met ? 0 : 1;
}
