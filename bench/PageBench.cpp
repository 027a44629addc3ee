#include <signal.h>
#include <sys/wait.h>
#include <unistd.h>

#include <array>
#include <chrono>
#include <cstdio>
#include <fstream>
#include <string>
#include <vector>

#include "bench/Goals.h"
#include "bench/PageLoad.h"
#include "platform/linux/ChildProcess.h"
#include "tests/web/Games.h"
#include "web/ResultsPages.h"

namespace {

using namespace std::chrono_literals;
using Clock = std::chrono::steady_clock;

constexpr int Games = 20;
constexpr int PlayersOfGame = 40;
constexpr int Phones = 200;
constexpr double Megabyte = 1024.0 * 1024;

/// The program that serves pages, in a process of its own.
class Server {
 public:
  Server() {
    Pipe orders;
    Pipe reports;
    StandardStreams streams;
    streams.Input = orders.ReadEnd.Number();
    streams.Output = reports.WriteEnd.Number();
    process_ = StartProcess({TESSARINE_RESULTS_PROGRAM, "127.0.0.1", "18600"}, streams, ProcessKind::Child);
    input_ = std::move(orders.WriteEnd);
    output_ = std::move(reports.ReadEnd);
    std::array<char, 5> bytes{};
    PageReportReader reader;
    reports.WriteEnd.Close();
    if (read(output_.Number(), bytes.data(), bytes.size()) == 5) {
      reader.Add({bytes.data(), bytes.size()});
    }
    if (const auto report = reader.Next()) {
      Port = static_cast<std::uint16_t>(report->Number);
    }
  }
  ~Server() {
    kill(process_, SIGKILL);
    waitpid(process_, nullptr, 0);
  }
  Server(const Server&) = delete;
  Server& operator=(const Server&) = delete;

  std::uint16_t Port = 0;

  void Send(const std::vector<PageFrame>& frames) const {
    for (const PageFrame& frame : frames) {
      const std::string bytes = EncodeFrame(frame);
      for (std::size_t at = 0; at < bytes.size();) {
        const ssize_t count = write(input_.Number(), bytes.data() + at, bytes.size() - at);
        if (count <= 0) {
          return;
        }
        at += static_cast<std::size_t>(count);
      }
    }
  }

  /// Resident memory in bytes.
  double Memory() const {
    std::ifstream status("/proc/" + std::to_string(process_) + "/status");
    for (std::string line; std::getline(status, line);) {
      if (line.starts_with("VmRSS:")) {
        return std::stod(line.substr(6)) * 1024;
      }
    }
    return 0;
  }

 private:
  pid_t process_ = 0;
  Descriptor input_;
  Descriptor output_;
};

/// Milliseconds for the pages of one more game, in both languages, until all is written.
double HandOver(ResultsPages& pages, const Server& server, int number) {
  const PublicGame game = FullGameOf(PlayersOfGame, number);
  const auto start = Clock::now();
  pages.Put(game, 0h);
  server.Send(pages.TakeChanges());
  return std::chrono::duration<double, std::milli>(Clock::now() - start).count();
}

bool MemoryHolds(const Server& server, const char* name) {
  constexpr double most = 20 * Megabyte;
  const double memory = server.Memory();
  std::array<char, 64> text{};
  std::snprintf(text.data(), text.size(), "%.1f MB", memory / Megabyte);
  return ReportGoal(name, memory / most, 1, text.data());
}

}  // namespace

int main() {
  const Server server;
  ResultsPages pages(Language::English);
  server.Send(pages.TakeAll());
  std::vector<double> times;
  for (int number = 1; number <= Games; ++number) {
    times.push_back(HandOver(pages, server, number));
  }
  constexpr double mostMilliseconds = 20;
  const double time = Median(times);
  bool met = ReportGoal("pages of a game of 40 rendered and sent / 20 ms", time / mostMilliseconds, 1,
                        TimesText(time * 1000, mostMilliseconds * 1000));
  met &= pages.Pages().contains("/en/g/1/");  // none of the games was dropped as too large
  const PageLoad load = LoadServer(server.Port, "/", Phones, 2s);
  met &= load.Failures == 0 && load.RequestsPerSecond > 0;
  met &= MemoryHolds(server, "memory with 20 games, after 200 phones / 20 MB");
  for (const auto& [path, body] : pages.Pages()) {
    met &= LoadServer(server.Port, path == "/missing" ? "/" : path, 1, 1ms).Failures == 0;
  }
  met &= MemoryHolds(server, "  the same after each page was asked for");
  std::printf("%-52s skipped: no server to compare with; %.0f a second, %zu failures\n",
              "requests for the board, 200 connections", load.RequestsPerSecond, load.Failures);
  return met ? 0 : 1;
}
