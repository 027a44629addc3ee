#pragma once

#include <chrono>
#include <fstream>
#include <functional>
#include <map>
#include <memory>
#include <optional>
#include <ostream>
#include <string>
#include <vector>

#include "sim/game/Evening.h"
#include "sim/line/DeviceLink.h"
#include "sim/venue/DeviceEntry.h"
#include "sim/venue/VenueOptions.h"

namespace sim {

/// The devices that the command line asks for, served from construction to destruction.
class Venue {
 public:
  /// `endVenue` may be called on any thread, as soon as there is nothing left to serve. Throws whatever
  /// starting a device throws, and std::runtime_error if a file cannot be written. `devices` must outlive the
  /// venue.
  Venue(const VenueOptions& options, std::function<void()> endVenue,
        const std::vector<DeviceEntry>& devices = Devices());
  Venue(const Venue&) = delete;
  Venue& operator=(const Venue&) = delete;

  /// Number of the game whose scores the guns have now, from 1.
  int GameNumber() const { return evening_.NumberAt(Elapsed()); }

  /// Writes "TITLE: DEVICE", one line per device.
  void TellDevices(std::ostream& out) const;
  /// Writes what the hosts did wrong.
  void TellHostFaults(std::ostream& out) const;

  bool TakesCommands() const;
  /// Hands `line` to the device whose name it begins with, or else to the first in the table that has such a
  /// command. Returns what to print, nothing for an empty line. Throws std::invalid_argument with a text for
  /// the user.
  std::string Obey(const std::string& line);

 private:
  struct ServedDevice {
    explicit ServedDevice(const DeviceEntry& entry) : Entry(entry) {}

    const DeviceEntry& Entry;
    std::map<std::string, std::ofstream, std::less<>> Files;
    StartedDevice Started;
    std::optional<DeviceLink> Link;
  };

  void Start(ServedDevice& device, const VenueOptions& options, const std::vector<GunScores>& game);
  std::ostream* Log(const std::optional<std::string>& path);
  std::function<std::optional<std::vector<GunScores>>()> NextGame() const;
  std::chrono::microseconds Elapsed() const;

  const Evening evening_;
  const std::chrono::steady_clock::time_point begin_ = std::chrono::steady_clock::now();
  std::function<void()> endVenue_;
  std::optional<std::ofstream> log_;
  std::vector<std::unique_ptr<ServedDevice>> devices_;
};

}  // namespace sim
