#include <poll.h>
#include <sys/eventfd.h>
#include <sys/signalfd.h>
#include <unistd.h>

#include <array>
#include <cerrno>
#include <csignal>
#include <cstdint>
#include <exception>
#include <fstream>
#include <iostream>
#include <optional>
#include <stdexcept>
#include <string>
#include <system_error>
#include <utility>
#include <vector>

#include "sim/BaseUnit.h"
#include "sim/DeviceLink.h"
#include "sim/FileDescriptor.h"
#include "sim/GameMaker.h"
#include "sim/VenueOptions.h"

namespace {

constexpr int exitFailure = 1;
constexpr int exitBadOptions = 2;

std::optional<std::ofstream> OpenOutput(const std::optional<std::string>& path) {
  if (!path) {
    return std::nullopt;
  }
  std::ofstream file(*path, std::ios::binary | std::ios::trunc);
  if (!file) {
    throw std::runtime_error("Cannot write " + *path);
  }
  return file;
}

// Must run before the first thread starts, so that no thread is ended by the signals that end the program.
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

bool InputHasEnded() {
  std::array<char, 256> ignored{};
  return ::read(STDIN_FILENO, ignored.data(), ignored.size()) <= 0;
}

void WaitForEnd(const sim::FileDescriptor& endSignals, const sim::FileDescriptor& finished, bool untilEof) {
  std::array<pollfd, 3> watched{pollfd{endSignals.Get(), POLLIN, 0}, pollfd{finished.Get(), POLLIN, 0},
                                pollfd{untilEof ? STDIN_FILENO : -1, POLLIN, 0}};
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
    if (watched[2].revents != 0 && InputHasEnded()) {
      return;
    }
  }
}

void Serve(const sim::VenueOptions& options, sim::BaseUnitAnswer answer) {
  const sim::FileDescriptor endSignals = CatchEndSignals();
  const sim::FileDescriptor finished(::eventfd(0, EFD_CLOEXEC));
  if (!endSignals.IsOpen() || !finished.IsOpen()) {
    throw std::system_error(errno, std::generic_category(), "signals");
  }
  std::optional<std::ofstream> log = OpenOutput(options.LogFile);
  std::optional<std::ofstream> frames = OpenOutput(options.FramesFile);
  sim::BaseUnit baseUnit({.Answer = std::move(answer),
                          .LinePace = options.Fast ? sim::Pace::Fast : sim::Pace::AsWired,
                          .Requests = options.Games,
                          .Log = log ? &*log : nullptr,
                          .Frames = frames ? &*frames : nullptr,
                          .OnFinished = [&finished] { ::eventfd_write(finished.Get(), 1); }});
  std::optional<sim::DeviceLink> link;
  if (options.Link) {
    link.emplace(*options.Link, baseUnit.DevicePath());
  }
  std::cout << "base unit: " << baseUnit.DevicePath() << std::endl;
  WaitForEnd(endSignals, finished, options.UntilEof);
}

void Complain(const std::exception& failure) {
  std::cerr << "tessarine-venue: " << failure.what() << '\n';
}

}  // namespace

int main(int argc, char** argv) {
  try {
    const sim::VenueOptions options = sim::ParseVenueOptions(std::vector<std::string>(argv + 1, argv + argc));
    if (options.Help) {
      std::cout << sim::VenueUsage();
      return 0;
    }
    Serve(options, sim::MakeBaseUnitAnswer(sim::MakeGame(options.Players, options.Seed), options.Failure,
                                           options.FailurePlace));
    return 0;
  } catch (const std::invalid_argument& failure) {
    Complain(failure);
    return exitBadOptions;
  } catch (const std::exception& failure) {
    Complain(failure);
    return exitFailure;
  }
}
