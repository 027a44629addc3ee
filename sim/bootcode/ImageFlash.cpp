#include "sim/bootcode/ImageFlash.h"

#include <algorithm>
#include <filesystem>
#include <iterator>
#include <stdexcept>

namespace sim {
namespace {

constexpr std::uint8_t Erased = 0xFF;
constexpr auto ReadAndWrite = std::ios::binary | std::ios::in | std::ios::out;

}  // namespace

ImageFlash::ImageFlash(const std::optional<std::string>& path) : bytes_(Rows * RowBytes, Erased) {
  if (!path) {
    return;
  }
  const bool existed = std::filesystem::exists(*path);
  file_.open(*path, existed ? ReadAndWrite : ReadAndWrite | std::ios::trunc);
  if (!file_) {
    throw std::runtime_error("Cannot write " + *path);
  }
  if (!existed) {
    Keep(0, bytes_.size());
    return;
  }
  if (std::filesystem::file_size(*path) != bytes_.size()) {
    throw std::runtime_error(*path + " is no program memory of " + std::to_string(bytes_.size()) + " bytes");
  }
  bytes_.assign(std::istreambuf_iterator<char>(file_), std::istreambuf_iterator<char>());
}

void ImageFlash::ErasePage(std::size_t page) {
  constexpr std::size_t pageBytes = RowsPerPage * RowBytes;
  std::fill_n(bytes_.begin() + static_cast<std::ptrdiff_t>(page * pageBytes), pageBytes, Erased);
  Keep(page * pageBytes, pageBytes);
}

bool ImageFlash::WriteRow(std::size_t row, std::span<const std::uint8_t> bytes) {
  bool taken = true;
  for (std::size_t i = 0; i < RowBytes; ++i) {
    std::uint8_t& cell = bytes_.at(row * RowBytes + i);
    cell &= bytes[i];
    taken = taken && cell == bytes[i];
  }
  Keep(row * RowBytes, RowBytes);
  return taken;
}

void ImageFlash::Keep(std::size_t from, std::size_t count) {
  if (file_.is_open()) {
    const std::string text(bytes_.begin() + static_cast<std::ptrdiff_t>(from),
                           bytes_.begin() + static_cast<std::ptrdiff_t>(from + count));
    file_.seekp(static_cast<std::streamoff>(from));
    file_ << text << std::flush;
  }
}

}  // namespace sim
