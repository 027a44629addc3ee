#include "sim/bootcode/BufferStore.h"

#include <stdexcept>
#include <string_view>
#include <utility>

namespace sim {

BufferStore::BufferStore(std::optional<std::string> path) : path_(std::move(path)) {
  if (path_) {
    file_.open(*path_, std::ios::binary | std::ios::app);
    if (!file_) {
      throw std::runtime_error("Cannot write " + *path_);
    }
  }
}

void BufferStore::Clear() {
  buffers_.clear();
  if (path_) {
    file_.close();
    file_.open(*path_, std::ios::binary | std::ios::trunc);
  }
}

void BufferStore::Add(std::span<const std::uint8_t> buffer) {
  constexpr std::string_view digits = "0123456789ABCDEF";
  buffers_.emplace_back(buffer.begin(), buffer.end());
  if (path_) {
    std::string line = ":";
    for (const std::uint8_t byte : buffer) {
      line += digits[byte >> 4U];
      line += digits[byte & 15U];
    }
    file_ << line << "\r\n" << std::flush;
  }
}

}  // namespace sim
