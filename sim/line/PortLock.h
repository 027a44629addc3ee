#pragma once

#include <algorithm>
#include <chrono>
#include <filesystem>
#include <string>
#include <thread>

namespace sim {

/// Waits until nobody holds the lock file of a new pseudo terminal, at most 1 s. The system gives the number
/// of one again as soon as it is closed, which is a moment before a program that had it open lets go of its
/// lock
/// (/var/lock/LCK..<device>, as the Filesystem Hierarchy Standard has it).
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
