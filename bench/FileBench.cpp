#include <benchmark/benchmark.h>

#include <pugixml.hpp>

#include "bench/FullGame.h"
#include "bench/Goals.h"
#include "core/gamefile/GameFile.h"

namespace {

const std::string& FullFile() {
  static const std::string bytes = [] {
    FullGame full(0);
    full.CalculateScores();
    return WriteGameFile(full.game, "None");
  }();
  return bytes;
}

void BareParse(benchmark::State& state) {
  while (state.KeepRunning()) {
    pugi::xml_document document;
    benchmark::DoNotOptimize(document.load_buffer(FullFile().data(), FullFile().size()).status);
  }
}
BENCHMARK(BareParse);

void Load(benchmark::State& state) {
  FullGame full(0);
  while (state.KeepRunning()) {
    full.game.Clear();
    ReadGameFile(FullFile(), full.game, [](const std::string&) {});
    full.CalculateScores();
  }
}
BENCHMARK(Load);

struct StringWriter : pugi::xml_writer {
  std::string Bytes;
  void write(const void* data, std::size_t size) override {
    Bytes.append(static_cast<const char*>(data), size);
  }
};

void BareSave(benchmark::State& state) {
  pugi::xml_document document;
  document.load_buffer(FullFile().data(), FullFile().size(), pugi::parse_full | pugi::parse_ws_pcdata);
  while (state.KeepRunning()) {
    StringWriter writer;
    document.save(writer, "", pugi::format_raw | pugi::format_no_declaration, pugi::encoding_utf8);
    benchmark::DoNotOptimize(writer.Bytes.data());
  }
}
BENCHMARK(BareSave);

void Save(benchmark::State& state) {
  FullGame full(0);
  full.CalculateScores();
  while (state.KeepRunning()) {
    benchmark::DoNotOptimize(WriteGameFile(full.game, "None").size());
  }
}
BENCHMARK(Save);

}  // namespace

int main(int argc, char** argv) {
  auto times = MedianTimes(argc, argv);
  bool met = ReportGoal("load the fullest game / bare parse", times["Load"] / times["BareParse"], 2,
                        TimesText(times["Load"], times["BareParse"]));
  met &= ReportGoal("save the fullest game / bare save", times["Save"] / times["BareSave"], 2,
                    TimesText(times["Save"], times["BareSave"]));
  return met ? 0 : 1;
}
