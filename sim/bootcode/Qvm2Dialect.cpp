#include "sim/bootcode/Qvm2Dialect.h"

#include <numeric>
#include <span>
#include <string_view>

namespace sim {
namespace {

constexpr std::uint8_t EraseCommand = 'E';
constexpr std::uint8_t WriteCommand = 'Z';
constexpr std::uint8_t Erased = 'b';
constexpr std::uint8_t Written = 'f';
constexpr std::uint8_t Again = 'c';
constexpr std::uint8_t WrongAddress = 'e';

constexpr std::size_t ErasePacketBytes = 6;
constexpr std::size_t WritePacketBytes = 198;
constexpr std::size_t HeadBytes = 5;  // command, address, count of what follows
constexpr std::size_t AddressesPerPage = 1024;
constexpr std::size_t AddressesPerRow = 128;

std::string Hex(std::size_t value) {
  constexpr std::string_view digits = "0123456789ABCDEF";
  std::string text(6, '0');
  for (auto digit = text.rbegin(); digit != text.rend(); ++digit, value /= 16) {
    *digit = digits[value % 16];
  }
  return text;
}

BootVerdict Refused(std::uint8_t answer, const std::string& what) {
  return {.Answer = answer, .Note = "fault: " + what, .Fault = "sent " + what};
}

}  // namespace

BootDialect::Heard Qvm2Dialect::Take(std::uint8_t byte) {
  if (packet_.empty() && byte != EraseCommand && byte != WriteCommand) {
    return Heard::Foreign;
  }
  packet_.push_back(byte);
  const std::size_t whole = packet_.front() == EraseCommand ? ErasePacketBytes : WritePacketBytes;
  return packet_.size() == whole ? Heard::Complete : Heard::More;
}

BootVerdict Qvm2Dialect::CarryOut() {
  BootVerdict verdict = Judge();
  packet_.clear();
  return verdict;
}

BootVerdict Qvm2Dialect::Judge() {
  if (std::accumulate(packet_.begin(), packet_.end(), 0U) % 256 != 0) {
    return Refused(Again, "a wrong checksum");
  }
  if (packet_[4] != packet_.size() - HeadBytes) {
    return Refused(Again, "a count of " + std::to_string(packet_[4]) + " before " +
                              std::to_string(packet_.size() - HeadBytes) + " bytes");
  }
  const std::size_t address = packet_[1] * std::size_t{65536} + packet_[2] * std::size_t{256} + packet_[3];
  return packet_.front() == EraseCommand ? Erase(address) : Write(address);
}

BootVerdict Qvm2Dialect::Erase(std::size_t address) {
  const std::size_t page = address / AddressesPerPage;
  if (address % AddressesPerPage != 0 || page >= ImageFlash::Pages) {
    return Refused(WrongAddress, "the address " + Hex(address) + " of no page");
  }
  flash_.ErasePage(page);
  return {.Answer = Erased, .Note = "page " + std::to_string(page) + " erased"};
}

BootVerdict Qvm2Dialect::Write(std::size_t address) {
  const std::size_t row = address / AddressesPerRow;
  if (address % AddressesPerRow != 0 || row >= ImageFlash::Rows) {
    return Refused(WrongAddress, "the address " + Hex(address) + " of no row");
  }
  BootVerdict verdict{.Answer = Written, .Note = "row " + std::to_string(row) + " written"};
  if (!flash_.WriteRow(row, std::span(packet_).subspan(HeadBytes, ImageFlash::RowBytes))) {
    verdict.Fault = "wrote row " + std::to_string(row) + " over what it held";
    verdict.Note += ", fault: over what it held";
  }
  return verdict;
}

}  // namespace sim
