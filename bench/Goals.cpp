#include "bench/Goals.h"

#include <benchmark/benchmark.h>

#include <algorithm>
#include <cstdio>

namespace {

/// Collects the times and prints nothing.
class Collector : public benchmark::BenchmarkReporter {
 public:
  bool ReportContext(const Context& /*context*/) override { return true; }
  void ReportRuns(const std::vector<Run>& runs) override {
    for (const Run& run : runs) {
      if (run.run_type == Run::RT_Iteration) {
        constexpr double microseconds = 1e6;
        Times[run.run_name.function_name].push_back(run.real_accumulated_time /
                                                    static_cast<double>(run.iterations) * microseconds);
      }
    }
  }

  std::map<std::string, std::vector<double>> Times;
};

}  // namespace

bool ReportGoal(const std::string& name, double ratio, double goal, const std::string& detail) {
  const bool met = ratio <= goal;
  std::printf("%-52s %8.3f  goal %6.3f  %-5s  %s\n", name.c_str(), ratio, goal, met ? "ok" : "short",
              detail.c_str());
  std::fflush(stdout);
  return met;
}

double Median(std::vector<double> values) {
  const auto middle = values.begin() + static_cast<std::ptrdiff_t>(values.size() / 2);
  std::nth_element(values.begin(), middle, values.end());
  return *middle;
}

std::map<std::string, double> MedianTimes(int argc, char** argv) {
  std::string interleave = "--benchmark_enable_random_interleaving=true";
  std::string repeat = "--benchmark_repetitions=9";
  std::string shortRuns = "--benchmark_min_time=0.05";
  std::vector<char*> arguments(argv, argv + argc);
  arguments.insert(arguments.begin() + 1, {interleave.data(), repeat.data(), shortRuns.data()});
  int count = static_cast<int>(arguments.size());
  benchmark::Initialize(&count, arguments.data());
  Collector collector;
  benchmark::RunSpecifiedBenchmarks(&collector);
  std::map<std::string, double> medians;
  for (const auto& [name, times] : collector.Times) {
    medians[name] = Median(times);
  }
  return medians;
}

std::string TimesText(double microseconds, double limitMicroseconds) {
  char text[64];
  std::snprintf(text, sizeof text, "%.1f us to %.1f us", microseconds, limitMicroseconds);
  return text;
}
