#include <signal.h>
#include <sys/wait.h>
#include <unistd.h>

#include <array>
#include <chrono>
#include <cstdio>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <stdexcept>
#include <string>
#include <thread>
#include <vector>

#include "bench/Goals.h"
#include "bench/PageLoad.h"
#include "bench/PagePhones.h"
#include "bench/PageServerPeer.h"
#include "bench/WindowWatch.h"
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

/// A folder that goes with its files.
struct ScratchFolder {
  ScratchFolder() {
    std::string pattern = std::filesystem::temp_directory_path() / "bench-pages-XXXXXX";
    Path = mkdtemp(pattern.data()) != nullptr ? pattern : throw std::runtime_error("no folder");
  }
  ~ScratchFolder() {
    std::error_code ignored;
    std::filesystem::remove_all(Path, ignored);
  }
  ScratchFolder(const ScratchFolder&) = delete;
  ScratchFolder& operator=(const ScratchFolder&) = delete;

  std::string Path;
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

/// Seconds after which the phones have the board of a game, from the moment when its scores are there.
bool PhonesFollow(ResultsPages& pages, const Server& server, int number) {
  constexpr double mostSeconds = 3.5;
  constexpr auto asSeenFrom = 3500ms;  // each has asked at least once, and at no time in particular
  PagePhones phones(server.Port, Phones);
  phones.GoOn(asSeenFrom);
  const auto scored = Clock::now();
  HandOver(pages, server, number);
  const std::vector<double> times = phones.NewPages(scored, 10s);
  constexpr std::size_t needed = std::size_t{Phones} * 95 / 100;
  const double time = times.size() >= needed ? times[needed - 1] : 1000;
  std::array<char, 96> text{};
  std::snprintf(text.data(), text.size(), "%.2f s for 95 of 100, %.2f s for the last of %zu", time,
                times.empty() ? 0 : times.back(), times.size());
  return ReportGoal("scores to the new board on 200 phones / 3.5 s", time / mostSeconds, 1, text.data()) &&
         phones.Failures() == 0;
}

/// Requests for the board in turns from both servers, each the median.
bool AsFastAsThePeer(const std::string& body, const Server& server) {
  constexpr const char* name = "requests for the board, nginx / own, 200 connections";
  constexpr double goal = 1 / 0.8;
  const std::string program = FindPageServerPeer();
  if (program.empty()) {
    std::printf("%-52s skipped: no nginx\n", name);
    return true;
  }
  const ScratchFolder folder;
  PageServerPeer peer(program, folder.Path, body);
  if (!peer.Answers()) {
    std::printf("%-52s skipped: nginx does not serve\n", name);
    return true;
  }
  std::vector<double> own;
  std::vector<double> others;
  std::size_t failures = 0;
  for (int round = 0; round < 5; ++round) {
    const PageLoad load = LoadServer(server.Port, "/", Phones, 1500ms);
    const PageLoad other = LoadServer(PageServerPeer::Port, "/", Phones, 1500ms);
    own.push_back(load.RequestsPerSecond);
    others.push_back(other.RequestsPerSecond);
    failures += load.Failures + other.Failures;
  }
  std::array<char, 96> text{};
  std::snprintf(text.data(), text.size(), "%.0f to %.0f a second, %zu failures", Median(others), Median(own),
                failures);
  return ReportGoal(name, Median(others) / Median(own), goal, text.data()) && failures == 0;
}

/// The longest delays of the program's own window in turns: while nobody asks for its pages, and while 200
/// connections do as fast as they can. Each the median of the turns.
bool WindowStaysPrompt() {
  constexpr const char* name = "main window's longest delay, with / without load, +5 ms";
  constexpr double mostMore = 5;
  static constexpr auto turn = 5500ms;  // the program looks after its server every five seconds
  constexpr int turns = 7;
  const ScratchFolder folder;
  WindowWatch window(TESSARINE_WATCHED_WINDOW, folder.Path);
  if (window.Port() == 0) {
    return ReportGoal(name, 1000, 1, "the window does not come up");
  }
  std::this_thread::sleep_for(turn);  // what a start leaves behind for later is done then
  std::vector<double> calm;
  std::vector<double> loaded;
  std::size_t failures = 0;
  for (int round = 0; round < turns; ++round) {
    calm.push_back(window.LongestDelay([] { std::this_thread::sleep_for(turn); }));
    loaded.push_back(
        window.LongestDelay([&] { failures += LoadServer(window.Port(), "/", Phones, turn).Failures; }));
  }
  std::array<char, 96> text{};
  std::snprintf(text.data(), text.size(), "%.1f ms to %.1f ms, %zu failures", Median(loaded), Median(calm),
                failures);
  return ReportGoal(name, Median(loaded) / (Median(calm) + mostMore), 1, text.data()) && failures == 0;
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
  met &= PhonesFollow(pages, server, Games + 1);
  met &= AsFastAsThePeer(pages.Pages().at("/"), server);
  met &= WindowStaysPrompt();
  return met ? 0 : 1;
}
