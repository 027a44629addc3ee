#pragma once

#include <cstddef>
#include <cstdint>
#include <fstream>
#include <optional>
#include <span>
#include <string>
#include <vector>

namespace sim {

/// The program memory of a device of the second kind: 512 pages of 8 rows of 192 bytes (3 for each
/// instruction). It is kept in a file, if there is one, which always holds all that was done.
class ImageFlash {
 public:
  static constexpr std::size_t Pages = 512;
  static constexpr std::size_t RowsPerPage = 8;
  static constexpr std::size_t Rows = Pages * RowsPerPage;
  static constexpr std::size_t RowBytes = 192;

  /// Takes the content of the file; makes one of a whole erased memory if there is none. Throws
  /// std::runtime_error if it cannot be used or has another length.
  explicit ImageFlash(const std::optional<std::string>& path);

  const std::vector<std::uint8_t>& Bytes() const { return bytes_; }

  void ErasePage(std::size_t page);
  /// Clears the bits that are clear in `row`, as flash does. False if some that it should set were clear.
  bool WriteRow(std::size_t row, std::span<const std::uint8_t> bytes);

 private:
  void Keep(std::size_t from, std::size_t count);

  std::vector<std::uint8_t> bytes_;
  std::fstream file_;
};

}  // namespace sim
