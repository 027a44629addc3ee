#include "sim/venue/Venue.h"

#include <algorithm>
#include <sstream>
#include <stdexcept>
#include <utility>

namespace sim {
namespace {

std::ofstream OpenOutput(const std::string& path) {
  std::ofstream file(path, std::ios::binary | std::ios::trunc);
  if (!file) {
    throw std::runtime_error("Cannot write " + path);
  }
  return file;
}

std::string FirstWord(std::string_view line) {
  std::istringstream words{std::string(line)};
  std::string word;
  words >> word;
  return word;
}

std::string BehindFirstWord(const std::string& line) {
  const std::size_t begin = line.find_first_not_of(" \t");
  const std::size_t end = line.find_first_of(" \t", begin);
  return end == std::string::npos ? "" : line.substr(end + 1);
}

bool HasCommand(const DeviceEntry& entry, const std::string& word) {
  return std::any_of(entry.Commands.begin(), entry.Commands.end(),
                     [&](const DeviceCommand& command) { return FirstWord(command.Usage) == word; });
}

}  // namespace

Venue::Venue(const VenueOptions& options, std::function<void()> endVenue,
             const std::vector<DeviceEntry>& devices)
    : evening_(options.Players, options.Seed, options.Evening), endVenue_(std::move(endVenue)) {
  const std::vector<GunScores> game = evening_.Game(1);
  for (const DeviceEntry& entry : devices) {
    if (options.Of(entry.Name).Served) {
      devices_.push_back(std::make_unique<ServedDevice>(entry));
      Start(*devices_.back(), options, game);
    }
  }
}

void Venue::Start(ServedDevice& device, const VenueOptions& options, const std::vector<GunScores>& game) {
  const DeviceOptions& own = options.Of(device.Entry.Name);
  const auto openFile = [&](std::string_view option) -> std::ostream* {
    const std::optional<std::string> path = own.File(option);
    return path ? &(device.Files[std::string(option)] = OpenOutput(*path)) : nullptr;
  };
  device.Started = device.Entry.Start({.Options = own,
                                       .Game = game,
                                       .NextGame = NextGame(),
                                       .LinePace = options.Fast ? Pace::Fast : Pace::AsWired,
                                       .Log = [&] { return Log(options.LogFile); },
                                       .File = openFile,
                                       .EndVenue = endVenue_});
  if (own.Link) {
    device.Link.emplace(*own.Link, device.Started.Served->DevicePath());
  }
}

std::function<std::optional<std::vector<GunScores>>()> Venue::NextGame() const {
  return [this, last = 1]() mutable -> std::optional<std::vector<GunScores>> {
    const int number = GameNumber();
    return std::exchange(last, number) != number ? std::optional(evening_.Game(number)) : std::nullopt;
  };
}

std::chrono::microseconds Venue::Elapsed() const {
  return std::chrono::duration_cast<std::chrono::microseconds>(std::chrono::steady_clock::now() - begin_);
}

std::ostream* Venue::Log(const std::optional<std::string>& path) {
  if (path && !log_) {
    log_ = OpenOutput(*path);
  }
  return log_ ? &*log_ : nullptr;
}

void Venue::TellDevices(std::ostream& out) const {
  for (const auto& device : devices_) {
    out << device->Entry.Title << ": " << device->Started.Served->DevicePath() << std::endl;
  }
}

void Venue::TellHostFaults(std::ostream& out) const {
  for (const auto& device : devices_) {
    const std::vector<std::string> faults = device->Started.Served->HostFaults();
    for (const std::string& fault : faults) {
      out << device->Entry.Title << ": " << fault << '\n';
    }
    if (!faults.empty() || device->Entry.FaultCount == TellFaultCount::Always) {
      out << device->Entry.Title << ": faults of the host: " << faults.size() << '\n';
    }
  }
}

bool Venue::TakesCommands() const {
  return std::any_of(devices_.begin(), devices_.end(),
                     [](const auto& device) { return !device->Entry.Commands.empty(); });
}

std::string Venue::Obey(const std::string& line) {
  const std::string word = FirstWord(line);
  if (word.empty()) {
    return {};
  }
  for (const auto& device : devices_) {
    if (device->Started.Obey && word == device->Entry.Name) {
      return device->Started.Obey(BehindFirstWord(line));
    }
  }
  for (const auto& device : devices_) {
    if (device->Started.Obey && HasCommand(device->Entry, word)) {
      return device->Started.Obey(line);
    }
  }
  throw std::invalid_argument("There is no command \"" + line + "\"");
}

}  // namespace sim
