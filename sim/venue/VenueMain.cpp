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
#include <functional>
#include <iostream>
#include <optional>
#include <stdexcept>
#include <string>
#include <system_error>
#include <utility>
#include <vector>

#include "sim/baseunit/BaseUnit.h"
#include "sim/game/GameMaker.h"
#include "sim/line/DeviceLink.h"
#include "sim/line/FileDescriptor.h"
#include "sim/line/LineInput.h"
#include "sim/onewire/ButtonCommands.h"
#include "sim/onewire/OneWireAdapter.h"
#include "sim/radio/RadioGun.h"
#include "sim/radio/RadioModem.h"
#include "sim/venue/VenueOptions.h"

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

void Complain(const std::exception& failure) {
  std::cerr << "tessarine-venue: " << failure.what() << '\n';
}

// Returns on a signal, when `finished` is raised, or at the input's end if `untilEof`. Lines of the input go
// to `obey`; without it the input is only watched for its end.
void WaitForEnd(const sim::FileDescriptor& endSignals, const sim::FileDescriptor& finished, bool untilEof,
                const std::function<void(const std::string&)>& obey) {
  std::array<pollfd, 3> watched{pollfd{endSignals.Get(), POLLIN, 0}, pollfd{finished.Get(), POLLIN, 0},
                                pollfd{untilEof || obey ? STDIN_FILENO : -1, POLLIN, 0}};
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

void ObeyAndTell(sim::OneWireAdapter& adapter, const std::string& line) {
  try {
    const std::string done = sim::ObeyButtonCommand(adapter, line);
    if (!done.empty()) {
      std::cout << done << std::endl;
    }
  } catch (const std::invalid_argument& failure) {
    Complain(failure);
  }
}

// The radio modem with its link and the copy of its guns' frames.
class ServedModem {
 public:
  ServedModem(const sim::VenueOptions& options, sim::Pace pace, std::ostream* log)
      : frames_(OpenOutput(options.RadioFramesFile)),
        modem_({.Guns =
                    sim::MakeRadioGuns(sim::MakeGame(options.Players, options.Seed), options.RadioAnswerTime),
                .Trouble = options.RadioTrouble,
                .LinePace = pace,
                .Log = log,
                .Frames = frames_ ? &*frames_ : nullptr}) {
    if (options.RadioLink) {
      link_.emplace(*options.RadioLink, modem_.DevicePath());
    }
  }

  const std::string& DevicePath() const { return modem_.DevicePath(); }

  void TellFaults() const {
    const std::vector<std::string> faults = modem_.Traffic().Faults;
    for (const std::string& fault : faults) {
      std::cerr << "radio modem: the host sent " << fault << '\n';
    }
    std::cerr << "radio modem: faults of the host: " << faults.size() << '\n';
  }

 private:
  std::optional<std::ofstream> frames_;
  sim::RadioModem modem_;
  std::optional<sim::DeviceLink> link_;
};

void Serve(const sim::VenueOptions& options, sim::BaseUnitAnswer answer) {
  const sim::FileDescriptor endSignals = CatchEndSignals();
  const sim::FileDescriptor finished(::eventfd(0, EFD_CLOEXEC));
  if (!endSignals.IsOpen() || !finished.IsOpen()) {
    throw std::system_error(errno, std::generic_category(), "signals");
  }
  std::optional<std::ofstream> log = OpenOutput(options.LogFile);
  std::optional<std::ofstream> frames = OpenOutput(options.FramesFile);
  const sim::Pace pace = options.Fast ? sim::Pace::Fast : sim::Pace::AsWired;
  sim::BaseUnit baseUnit({.Answer = std::move(answer),
                          .LinePace = pace,
                          .Requests = options.Games,
                          .Log = log ? &*log : nullptr,
                          .Frames = frames ? &*frames : nullptr,
                          .OnFinished = [&finished] { ::eventfd_write(finished.Get(), 1); }});
  std::optional<sim::DeviceLink> link;
  if (options.Link) {
    link.emplace(*options.Link, baseUnit.DevicePath());
  }
  std::optional<sim::OneWireAdapter> oneWire;
  std::optional<sim::DeviceLink> oneWireLink;
  std::function<void(const std::string&)> obey;
  if (options.OneWire) {
    oneWire.emplace(sim::OneWireAdapterSettings{.Failure = options.AdapterFailure,
                                                .FailurePlace = options.AdapterFailurePlace,
                                                .LinePace = pace,
                                                .Log = log ? &*log : nullptr});
    if (options.AdapterLink) {
      oneWireLink.emplace(*options.AdapterLink, oneWire->DevicePath());
    }
    obey = [&adapter = *oneWire](const std::string& line) { ObeyAndTell(adapter, line); };
  }
  std::optional<ServedModem> modem;
  if (options.Radio) {
    modem.emplace(options, pace, log ? &*log : nullptr);
  }
  std::cout << "base unit: " << baseUnit.DevicePath() << std::endl;
  if (oneWire) {
    std::cout << "1-wire adapter: " << oneWire->DevicePath() << std::endl;
  }
  if (modem) {
    std::cout << "radio modem: " << modem->DevicePath() << std::endl;
  }
  WaitForEnd(endSignals, finished, options.UntilEof, obey);
  if (modem) {
    modem->TellFaults();
  }
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
