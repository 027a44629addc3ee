#include <poll.h>
#include <sys/eventfd.h>
#include <sys/signalfd.h>
#include <sys/timerfd.h>
#include <unistd.h>

#include <array>
#include <cerrno>
#include <chrono>
#include <csignal>
#include <cstdint>
#include <exception>
#include <functional>
#include <iostream>
#include <stdexcept>
#include <string>
#include <system_error>
#include <vector>

#include "sim/line/FileDescriptor.h"
#include "sim/line/LineInput.h"
#include "sim/venue/Venue.h"
#include "sim/venue/VenueOptions.h"
#include "sim/venue/VenueUsage.h"

namespace {

constexpr int ExitFailure = 1;
constexpr int ExitBadOptions = 2;

// Must run before the first thread starts, so that all threads inherit the mask and the signals arrive only
// at the descriptor.
sim::FileDescriptor CatchEndSignals() {
  sigset_t signals;
  sigemptyset(&signals);
  for (const int signal : {SIGTERM, SIGINT, SIGHUP}) {
    sigaddset(&signals, signal);
  }
  pthread_sigmask(SIG_BLOCK, &signals, nullptr);
  std::signal(SIGPIPE, SIG_IGN);
  return sim::FileDescriptor(::signalfd(-1, &signals, SFD_CLOEXEC));
}

// Readable whenever so much time has passed; never for 0.
sim::FileDescriptor Ticking(std::chrono::seconds every) {
  sim::FileDescriptor ticks(::timerfd_create(CLOCK_MONOTONIC, TFD_CLOEXEC | TFD_NONBLOCK));
  const timespec distance{.tv_sec = every.count(), .tv_nsec = 0};
  const itimerspec times{.it_interval = distance, .it_value = distance};
  ::timerfd_settime(ticks.Get(), 0, &times, nullptr);
  return ticks;
}

/// What the program waits for.
struct Awaited {
  const sim::FileDescriptor& EndSignals;
  const sim::FileDescriptor& Finished;
  const sim::FileDescriptor& GameTicks;
};

void Complain(const std::exception& failure) {
  std::cerr << "tessarine-venue: " << failure.what() << '\n';
}

// Returns on a signal, when all is finished, or at the input's end if `untilEof`. Lines of the input go to
// `obey`; without it the input is only watched for its end. Calls `tellGame` at each tick.
void WaitForEnd(const Awaited& awaited, bool untilEof, const std::function<void(const std::string&)>& obey,
                const std::function<void()>& tellGame) {
  std::array<pollfd, 4> watched{
      pollfd{awaited.EndSignals.Get(), POLLIN, 0}, pollfd{awaited.Finished.Get(), POLLIN, 0},
      pollfd{untilEof || obey ? STDIN_FILENO : -1, POLLIN, 0}, pollfd{awaited.GameTicks.Get(), POLLIN, 0}};
  sim::LineInput input(STDIN_FILENO);
  for (;;) {
    if (::poll(watched.data(), watched.size(), -1) < 0) {
      if (errno != EINTR) {
        throw std::system_error(errno, std::generic_category(), "poll");
      }
      continue;
    }
    if (watched[0].revents != 0 || watched[1].revents != 0) {
      return;
    }
    if (std::uint64_t ticks = 0;
        watched[3].revents != 0 && ::read(watched[3].fd, &ticks, sizeof ticks) == sizeof ticks) {
      tellGame();
    }
    if (watched[2].revents != 0) {
      for (const std::string& line : input.Read()) {
        if (obey) {
          obey(line);
        }
      }
      if (input.HasEnded() && untilEof) {
        return;
      }
      if (input.HasEnded()) {
        watched[2].fd = -1;
      }
    }
  }
}

void ObeyAndTell(sim::Venue& venue, const std::string& line) {
  try {
    const std::string done = venue.Obey(line);
    if (!done.empty()) {
      std::cout << done << std::endl;
    }
  } catch (const std::invalid_argument& failure) {
    Complain(failure);
  }
}

void Serve(const sim::VenueOptions& options) {
  const sim::FileDescriptor endSignals = CatchEndSignals();
  const sim::FileDescriptor finished(::eventfd(0, EFD_CLOEXEC));
  if (!endSignals.IsOpen() || !finished.IsOpen()) {
    throw std::system_error(errno, std::generic_category(), "signals");
  }
  sim::Venue venue(options, [&finished] { ::eventfd_write(finished.Get(), 1); });
  std::function<void(const std::string&)> obey;
  if (venue.TakesCommands()) {
    obey = [&venue](const std::string& line) { ObeyAndTell(venue, line); };
  }
  const sim::FileDescriptor gameTicks = Ticking(options.Evening);
  venue.TellDevices(std::cout);
  WaitForEnd({.EndSignals = endSignals, .Finished = finished, .GameTicks = gameTicks}, options.UntilEof, obey,
             [&venue] { std::cout << "game " << venue.GameNumber() << std::endl; });
  venue.TellHostFaults(std::cerr);
}

}  // namespace

int main(int argc, char** argv) {
  try {
    const sim::VenueOptions options = sim::ParseVenueOptions(std::vector<std::string>(argv + 1, argv + argc));
    if (options.Help) {
      std::cout << sim::VenueUsage();
      return 0;
    }
    Serve(options);
    return 0;
  } catch (const std::invalid_argument& failure) {
    Complain(failure);
    return ExitBadOptions;
  } catch (const std::exception& failure) {
    Complain(failure);
    return ExitFailure;
  }
}
