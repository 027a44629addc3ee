#pragma once

#include <algorithm>
#include <chrono>
#include <filesystem>
#include <string>
#include <thread>

namespace sim {

/// Waits, at most 1 s, until a new pseudo terminal has no lock file. The system reuses a terminal's number as
/// soon as it is closed, a moment before the program that had it open removes its lock
/// (/var/lock/LCK..<device>, as in the Filesystem Hierarchy Standard).
inline void AwaitPortUnlocked(const std::string& device) {
  const std::string devices = "/dev/";
  std::string name = device.starts_with(devices) ? device.substr(devices.size()) : device;
  std::replace(name.begin(), name.end(), '/', '_');
  const std::filesystem::path lock = "/var/lock/LCK.." + name;
  const auto end = std::chrono::steady_clock::now() + std::chrono::seconds(1);
  std::error_code none;
  while (std::filesystem::exists(lock, none) && std::chrono::steady_clock::now() < end) {
    std::this_thread::sleep_for(std::chrono::milliseconds(1));
  }
}

}  // namespace sim
