#include <sys/types.h>
#include <unistd.h>

#include <QElapsedTimer>
#include <QGuiApplication>
#include <QImage>
#include <QPixmap>
#include <QProcess>
#include <QRect>
#include <QScreen>
#include <QThread>
#include <algorithm>
#include <csignal>
#include <cstdio>
#include <cstdlib>
#include <string>
#include <utility>
#include <vector>

#include "bench/FullGame.h"
#include "bench/Goals.h"
#include "core/gamefile/GameFile.h"
#include "platform/linux/LinuxFiles.h"

namespace {

constexpr int Patience = 60'000;  ///< milliseconds

[[noreturn]] void GiveUp(const std::string& text) {
  std::fprintf(stderr, "bench-opening: %s\n", text.c_str());
  std::exit(1);
}

QImage Screen(const QRect& part) {
  const QPixmap seen =
      QGuiApplication::primaryScreen()->grabWindow(0, part.x(), part.y(), part.width(), part.height());
  return seen.toImage().convertToFormat(QImage::Format_RGB32);
}

QImage WholeScreen() {
  return Screen(QGuiApplication::primaryScreen()->geometry());
}

/// The screen once nothing on it has changed for a while.
QImage SettledScreen() {
  constexpr int calm = 1500;
  constexpr int step = 50;
  QElapsedTimer all;
  all.start();
  QElapsedTimer unchanged;
  unchanged.start();
  QImage last = WholeScreen();
  while (unchanged.elapsed() < calm) {
    QThread::msleep(step);
    QImage now = WholeScreen();
    if (now != last) {
      last = std::move(now);
      unchanged.restart();
    }
    if (all.elapsed() > Patience) {
      GiveUp("the screen never comes to rest");
    }
  }
  return last;
}

/// What the eye takes for "it is there": nearly all of the pixels in which `after` differs from `before`.
class Appearance {
 public:
  Appearance(const QImage& before, const QImage& after) {
    QRect place;
    for (int y = 0; y < after.height(); ++y) {
      for (int x = 0; x < after.width(); ++x) {
        if (before.pixel(x, y) != after.pixel(x, y)) {
          changed_.push_back({x, y, after.pixel(x, y)});
          place |= QRect(x, y, 1, 1);
        }
      }
    }
    place_ = place;
    if (changed_.size() < Fewest) {
      GiveUp("nothing to see has appeared");
    }
  }

  bool IsThere() const {
    const QImage now = Screen(place_);
    const auto same = std::count_if(changed_.begin(), changed_.end(), [&](const Pixel& pixel) {
      return now.pixel(pixel.X - place_.x(), pixel.Y - place_.y()) == pixel.Colour;
    });
    // A cursor may blink, and the time of day may be another one.
    return static_cast<double>(same) > 0.98 * static_cast<double>(changed_.size());
  }

 private:
  static constexpr std::size_t Fewest = 1000;

  struct Pixel {
    int X;
    int Y;
    QRgb Colour;
  };
  std::vector<Pixel> changed_;
  QRect place_;
};

/// A program that runs, with all that it starts, until this object goes.
class Running {
 public:
  explicit Running(const QString& program, const QString& file = {}) {
    process_.setChildProcessModifier([] { setpgid(0, 0); });
    process_.setStandardErrorFile(QProcess::nullDevice());
    process_.setStandardOutputFile(QProcess::nullDevice());
    process_.start(program, file.isEmpty() ? QStringList() : QStringList(file));
    if (!process_.waitForStarted(Patience)) {
      GiveUp("cannot start " + program.toStdString());
    }
    group_ = static_cast<pid_t>(process_.processId());
  }
  ~Running() {
    kill(-group_, SIGKILL);
    process_.waitForFinished(Patience);
    QThread::msleep(Clearing);
  }
  Running(const Running&) = delete;
  Running& operator=(const Running&) = delete;

 private:
  static constexpr int Clearing = 300;  ///< until its windows are gone, milliseconds
  QProcess process_;
  pid_t group_ = 0;
};

/// Milliseconds until it is there.
double TimeUntil(const Appearance& appearance, const QElapsedTimer& since) {
  while (!appearance.IsThere()) {
    QThread::usleep(500);
    if (since.elapsed() > Patience) {
      GiveUp("what should appear does not");
    }
  }
  return static_cast<double>(since.nsecsElapsed()) / 1e6;
}

/// What is to be seen of the program, learned from it once.
struct Appearances {
  Appearance Window;  ///< its main window, without a game
  Appearance Game;    ///< the scored board in that window
};

Appearances Learn(const QString& program, const QString& game) {
  const QImage blank = SettledScreen();
  const Running first(program);
  const QImage empty = SettledScreen();
  const Running second(program, game);
  const QImage full = SettledScreen();
  return {Appearance(blank, empty), Appearance(empty, full)};
}

double TimeOfStart(const QString& program, const Appearance& window) {
  QElapsedTimer since;
  since.start();
  const Running running(program);
  return TimeUntil(window, since);
}

class Openings {
 public:
  Openings(QString program, QString game)
      : program_(std::move(program)), game_(std::move(game)), seen_(Learn(program_, game_)) {}

  void Measure(int runs) {
    for (int i = 0; i < runs; ++i) {
      starts_.push_back(TimeOfStart(program_, seen_.Window));
      closed_.push_back(IntoClosed());
      running_.push_back(IntoRunning());
    }
  }

  /// `load` is what Load Game takes from the chosen file to the scored board, in milliseconds.
  bool Report(const std::string& game, double load) const {
    const double allowed = Median(starts_) + load + 50;
    char detail[160];
    std::snprintf(detail, sizeof detail, "%.0f ms to %.0f ms (start %.0f, load %.0f)", Median(closed_),
                  allowed, Median(starts_), load);
    const bool closed = ReportGoal("double click of " + game + ", program closed / start + load + 50 ms",
                                   Median(closed_) / allowed, 1, detail);
    constexpr double atMost = 200;
    std::snprintf(detail, sizeof detail, "%.0f ms, at most %.0f", Median(running_),
                  *std::max_element(running_.begin(), running_.end()));
    return ReportGoal("double click of " + game + ", program running / 200 ms", Median(running_) / atMost, 1,
                      detail) &&
           closed;
  }

 private:
  double IntoClosed() const {
    QElapsedTimer since;
    since.start();
    const Running running(program_, game_);
    return TimeUntil(seen_.Game, since);
  }
  double IntoRunning() const {
    constexpr int untilIdle = 4000;  // the word processor starts behind the window
    const Running first(program_);
    QThread::msleep(untilIdle);
    QElapsedTimer since;
    since.start();
    const Running second(program_, game_);
    return TimeUntil(seen_.Game, since);
  }

  const QString program_;
  const QString game_;
  const Appearances seen_;
  std::vector<double> starts_;
  std::vector<double> closed_;
  std::vector<double> running_;
};

/// A file with a game of that many players, each hit by every other one.
QString GameOf(int players, const std::string& folder) {
  FullGame full(0);
  for (int index = players + 1; index <= PlayerCount; ++index) {
    full.game.Players(index).Active = false;
    for (int shooter = 1; shooter <= PlayerCount; ++shooter) {
      full.game.Players(index).HitByPlayer(shooter) = 0;
    }
  }
  for (int index = 1; index <= players; ++index) {
    for (int shooter = players + 1; shooter <= PlayerCount; ++shooter) {
      full.game.Players(index).HitByPlayer(shooter) = 0;
    }
  }
  full.CalculateScores();
  const std::string file = folder + "/" + std::to_string(players) + " players.game.xml";
  LinuxFiles().Replace(file, WriteGameFile(full.game, "None"));
  return QString::fromStdString(file);
}

/// Milliseconds that Load Game takes, as the program of the benchmarks tells them.
double TimeOfLoad(const QString& program, const QString& game) {
  constexpr int runs = 7;
  std::vector<double> times;
  for (int i = 0; i < runs; ++i) {
    QProcess process;
    process.start(program, {game, QStringLiteral("--tell")});
    if (!process.waitForFinished(Patience) || process.exitCode() != 0) {
      GiveUp(program.toStdString() + " failed");
    }
    times.push_back(process.readAllStandardOutput().toDouble());
  }
  return Median(times);
}

}  // namespace

/// bench-opening: from the start of a program to what is to be seen on the screen, which should be empty and
/// of this benchmark alone. XDG_DATA_HOME must name a folder with the program's data.
int main(int argc, char** argv) {
  const char* const data = std::getenv("XDG_DATA_HOME");
  if (data == nullptr || argc > 1) {
    std::fprintf(stderr, "usage: XDG_DATA_HOME=FOLDER bench-opening\n");
    return 2;
  }
  const QGuiApplication application(argc, argv);
  const QString folder = QCoreApplication::applicationDirPath();
  const QString program = folder + QStringLiteral("/tessarine");
  constexpr int runs = 9;
  bool met = true;
  for (const int players : {24, PlayerCount}) {
    const QString game = GameOf(players, data);
    Openings openings(program, game);
    openings.Measure(runs);
    met &= openings.Report("a game of " + std::to_string(players),
                           TimeOfLoad(folder + QStringLiteral("/bench-main-window"), game));
  }
  return met ? 0 : 1;
}
