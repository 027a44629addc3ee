#pragma once

#include <filesystem>

namespace sim {

/// A symbolic link that gives a simulated device a fixed name while this object exists.
class DeviceLink {
 public:
  /// Replaces a symbolic link left at `path`, but nothing else. Throws std::filesystem::filesystem_error.
  DeviceLink(std::filesystem::path path, std::filesystem::path device);
  /// Removes the link unless it points elsewhere by now.
  ~DeviceLink();
  DeviceLink(const DeviceLink&) = delete;
  DeviceLink& operator=(const DeviceLink&) = delete;

 private:
  std::filesystem::path path_;
  std::filesystem::path device_;
};

}  // namespace sim
