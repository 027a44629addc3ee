#include "sim/line/WireLog.h"

#include <iomanip>
#include <sstream>
#include <syncstream>
#include <utility>

namespace sim {

WireLog::WireLog(std::ostream* out, std::string device)
    : out_(out), device_(std::move(device)), start_(std::chrono::steady_clock::now()) {}

void WireLog::ToHost(std::span<const std::uint8_t> bytes) {
  Row("->", bytes, {});
}

void WireLog::FromHost(std::uint8_t byte, std::string_view note) {
  Row("<-", {&byte, 1}, note);
}

void WireLog::FromHost(std::span<const std::uint8_t> bytes, std::string_view note) {
  Row("<-", bytes, note);
}

void WireLog::Note(std::string_view note) {
  Row("--", {}, note);
}

void WireLog::Row(std::string_view direction, std::span<const std::uint8_t> bytes, std::string_view note) {
  if (out_ == nullptr) {
    return;
  }
  const std::chrono::duration<double> elapsed = std::chrono::steady_clock::now() - start_;
  std::ostringstream row;
  row << std::fixed << std::setprecision(6) << std::setw(12) << elapsed.count() << ' ' << device_ << ' '
      << direction;
  row << std::hex << std::uppercase << std::setfill('0');
  for (const std::uint8_t byte : bytes) {
    row << ' ' << std::setw(2) << static_cast<unsigned>(byte);
  }
  if (!note.empty()) {
    row << ' ' << note;
  }
  row << '\n';
  // Devices on different threads may share the stream.
  std::osyncstream(*out_) << row.str() << std::flush;
}

}  // namespace sim
