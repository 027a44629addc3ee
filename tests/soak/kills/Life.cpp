#include "tests/soak/kills/Life.h"

#include <fcntl.h>
#include <poll.h>
#include <sys/prctl.h>
#include <sys/wait.h>
#include <unistd.h>

#include <algorithm>
#include <array>
#include <csignal>
#include <cstdlib>
#include <exception>
#include <fstream>
#include <thread>

#include "sim/line/FileDescriptor.h"

namespace {

using SteadyClock = std::chrono::steady_clock;

constexpr int TroubleExit = 3;

struct Pipe {
  Pipe() {
    std::array<int, 2> ends{};
    if (pipe2(ends.data(), O_CLOEXEC) != 0) {
      throw std::runtime_error("no pipe");
    }
    Reading = sim::FileDescriptor(ends[0]);
    Writing = sim::FileDescriptor(ends[1]);
  }
  sim::FileDescriptor Reading;
  sim::FileDescriptor Writing;
};

void Report(const Pipe& pipe, int step) {
  if (write(pipe.Writing.Get(), &step, sizeof step) != sizeof step) {
    throw std::runtime_error("nobody listens");
  }
}

/// The child's whole life. Writes why it ended, if it did so by itself, into the folder.
[[noreturn]] void Live(Work& work, const std::filesystem::path& folder, int done, Lie lie, const Pipe& pipe) {
  try {
    if (lie == Lie::Crash) {
      std::abort();
    }
    if (lie == Lie::Damaged) {
      for (const auto& entry : std::filesystem::directory_iterator(folder)) {
        if (entry.is_regular_file()) {
          std::filesystem::resize_file(entry.path(), entry.file_size() / 2);
        }
      }
    }
    const int ahead = lie == Lie::Lost ? 5 : 0;
    const int behind = lie == Lie::Doubled ? 5 : 0;
    work.Run(folder, done + 1, [&](int step) {
      if (step - behind > done) {
        Report(pipe, step + ahead - behind);
      }
    });
    _exit(0);
  } catch (const std::exception& failure) {
    std::ofstream(folder / "failure") << failure.what();
  }
  _exit(TroubleExit);
}

/// All numbers reported so far; the last of them counts.
void TakeReports(const Pipe& pipe, int& reported) {
  pollfd ready{pipe.Reading.Get(), POLLIN, 0};
  while (poll(&ready, 1, 0) == 1 && (ready.revents & POLLIN) != 0) {
    int step = 0;
    if (read(pipe.Reading.Get(), &step, sizeof step) != sizeof step) {
      return;
    }
    reported = step;
  }
}

/// Waits for `child` and for all that it started, which must go with it; false if some of that stays.
bool AwaitEnd(pid_t child, int& status) {
  constexpr std::chrono::seconds limit(20);
  waitpid(child, &status, 0);
  const SteadyClock::time_point end = SteadyClock::now() + limit;
  pid_t other = 0;
  while ((other = waitpid(-1, nullptr, WNOHANG)) >= 0) {
    if (SteadyClock::now() > end) {
      return false;
    }
    if (other == 0) {
      std::this_thread::sleep_for(std::chrono::milliseconds(5));
    }
  }
  return true;
}

void Judge(Work& work, const std::filesystem::path& folder, Life& life) {
  constexpr int reach = 12;
  std::string state;
  try {
    state = work.StateIn(folder);
  } catch (const std::exception& failure) {
    life.What = Life::Damaged;
    life.Reason = failure.what();
    return;
  }
  // What was being done at the death may be there or not, but whole.
  for (int steps = life.Reported; steps <= life.Reported + 1; ++steps) {
    if (work.StateAfter(steps) == state) {
      life.Found = steps;
      return;
    }
  }
  life.What = Life::Damaged;
  for (int steps = std::max(0, life.Reported - reach); steps <= life.Reported + reach; ++steps) {
    if (work.StateAfter(steps) == state) {
      life.What = steps < life.Reported ? Life::Lost : Life::Doubled;
    }
  }
  life.Reason = "found in " + folder.string() + ":\n" + state + "after step " +
                std::to_string(life.Reported) + " it must be:\n" + work.StateAfter(life.Reported);
}

}  // namespace

Life LiveAndDie(Work& work, const std::filesystem::path& folder, int done, std::chrono::microseconds time,
                Lie lie) {
  prctl(PR_SET_CHILD_SUBREAPER, 1);  // what a child leaves behind becomes a child of this process
  Life life;
  life.Reported = done;
  Pipe pipe;
  const pid_t child = fork();
  if (child == 0) {
    pipe.Reading.Close();
    Live(work, folder, done, lie, pipe);
  }
  pipe.Writing.Close();
  const SteadyClock::time_point death = SteadyClock::now() + time;
  while (SteadyClock::now() < death) {
    TakeReports(pipe, life.Reported);
    const auto left = std::chrono::duration_cast<std::chrono::microseconds>(death - SteadyClock::now());
    std::this_thread::sleep_for(
        std::clamp(left, std::chrono::microseconds(0), std::chrono::microseconds(2000)));
  }
  kill(child, SIGKILL);
  int status = 0;
  const bool allGone = AwaitEnd(child, status);
  TakeReports(pipe, life.Reported);
  life.Killed = WIFSIGNALED(status) && WTERMSIG(status) == SIGKILL;
  Judge(work, folder, life);
  if (life.What == Life::Fine && !life.Killed && !(WIFEXITED(status) && WEXITSTATUS(status) == 0)) {
    std::ifstream failure(folder / "failure");
    life.What = Life::Crashed;
    life.Reason = {std::istreambuf_iterator<char>(failure), {}};
  }
  if (life.What == Life::Fine && !allGone) {
    life.What = Life::Hung;
    life.Reason = "a process stayed behind";
  }
  return life;
}
