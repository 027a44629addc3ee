#pragma once

#include <cstdint>
#include <fstream>
#include <optional>
#include <span>
#include <string>
#include <vector>

namespace sim {

/// What a device of the first kind was given: the buffers as they came, whose meaning only the real device
/// knows. It is kept in a file, if there is one: a line for each, ":" and hexadecimal digits, as in a
/// firmware file.
class BufferStore {
 public:
  /// Throws std::runtime_error if the file cannot be written. What it holds stays until Clear.
  explicit BufferStore(std::optional<std::string> path);

  const std::vector<std::vector<std::uint8_t>>& Buffers() const { return buffers_; }

  void Clear();
  void Add(std::span<const std::uint8_t> buffer);

 private:
  std::optional<std::string> path_;
  std::ofstream file_;
  std::vector<std::vector<std::uint8_t>> buffers_;
};

}  // namespace sim
