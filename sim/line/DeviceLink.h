#pragma once

#include <filesystem>

namespace sim {

/// A symbolic link that gives a simulated device a lasting name for as long as the object lives.
class DeviceLink {
 public:
  /// Takes the place of a link left at `path`, but of nothing else. Throws std::filesystem::filesystem_error.
  DeviceLink(std::filesystem::path path, std::filesystem::path device);
  /// Removes the link unless it has come to lead elsewhere.
  ~DeviceLink();
  DeviceLink(const DeviceLink&) = delete;
  DeviceLink& operator=(const DeviceLink&) = delete;

 private:
  std::filesystem::path path_;
  std::filesystem::path device_;
};

}  // namespace sim
