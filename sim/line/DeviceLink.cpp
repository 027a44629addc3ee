#include "sim/line/DeviceLink.h"

#include <system_error>
#include <utility>

namespace sim {

DeviceLink::DeviceLink(std::filesystem::path path, std::filesystem::path device)
    : path_(std::move(path)), device_(std::move(device)) {
  if (std::filesystem::is_symlink(std::filesystem::symlink_status(path_))) {
    std::filesystem::remove(path_);
  }
  std::filesystem::create_symlink(device_, path_);
}

DeviceLink::~DeviceLink() {
  std::error_code failure;
  if (std::filesystem::read_symlink(path_, failure) == device_) {
    std::filesystem::remove(path_, failure);
  }
}

}  // namespace sim
