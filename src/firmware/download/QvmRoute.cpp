#include "firmware/download/QvmRoute.h"

#include <array>
#include <functional>
#include <limits>
#include <numeric>
#include <string>

#include "core/text/NumberForms.h"
#include "firmware/files/HexConvert.h"
#include "firmware/files/QvmLines.h"
#include "platform/RuntimeError.h"

namespace {

constexpr int MostErrorsOfALine = 10;
constexpr std::array<std::uint8_t, 3> SetUpBytes = {0x00, 0x70, 0x8F};

std::uint64_t WireBytesOf(std::string_view line) {
  return 1 + line.size() / 2;  // the command for its ":"
}

/// Shows the digits of a line at first, and what is left of them at the end. Not in between: a line is
/// converted in less than a millisecond.
class ShownDigits {
 public:
  ShownDigits(FirmwareDisplay& display, const std::string_view& digits) : display_(display), digits_(digits) {
    display_.SetDigits(std::string(digits_));
  }
  ~ShownDigits() { display_.SetDigits(std::string(digits_)); }
  ShownDigits(const ShownDigits&) = delete;
  ShownDigits& operator=(const ShownDigits&) = delete;

 private:
  FirmwareDisplay& display_;
  const std::string_view& digits_;
};

/// Removes the first two characters.
void RemovePair(std::string_view& digits) {
  if (digits.size() < 2) {
    throw RuntimeError(Fault::InvalidProcedureCall);
  }
  digits.remove_prefix(2);
}

std::uint8_t ByteOf(std::int16_t value) {
  if (value > std::numeric_limits<std::uint8_t>::max()) {
    throw RuntimeError(Fault::Overflow);
  }
  return static_cast<std::uint8_t>(value);
}

}  // namespace

DownloadStep QvmRoute::Transfer(const std::vector<std::string_view>& bufferLines) {
  if (const DownloadStep end = Begin()) {
    return end;
  }
  const std::uint64_t all = std::transform_reduce(bufferLines.begin(), bufferLines.end(), std::uint64_t{0},
                                                  std::plus<>(), WireBytesOf);
  std::uint64_t sent = 0;
  std::int32_t codeWords = 0;
  for (const std::string_view line : bufferLines) {
    if (const DownloadStep end = line_.CheckAbort()) {
      return end;
    }
    // The figure lags by one line.
    codeWords = RoundToInt32(codeWords + static_cast<long double>(lineBytes_.size()) / 2);
    display_.SetCurrentBuffer(std::string(line));
    display_.SetStatus("Loaded " + std::to_string(codeWords) + " code words");
    if (bufferLines.size() == 1) {
      throw RuntimeError(Fault::Overflow);  // the bar's share would be 0 / 0
    }
    display_.SetBar(static_cast<double>(lineNumber_) / static_cast<double>(bufferLines.size() - 1));
    display_.SetSent(sent, all);
    ++lineNumber_;
    if (const DownloadStep end = SendLine(line.substr(1))) {
      return end;
    }
    sent += WireBytesOf(line);
  }
  stage_ = FirmwareStage::Finishing;
  return line_.Ask("F", "f");
}

DownloadStep QvmRoute::Begin() {
  if (const DownloadStep end = line_.SendString("P")) {
    return end;
  }
  const DownloadReply product = line_.Await("pd", DownloadLine::First::Abort);
  if (product.End) {
    return product.End;
  }
  if (product.Character == 'd') {
    return FirmwareEnd::WrongProduct;
  }
  stage_ = FirmwareStage::Writing;
  if (const DownloadStep end = line_.Ask("B", "b")) {
    return end;
  }
  if (const DownloadStep end = line_.SendString("S")) {
    return end;
  }
  for (const std::uint8_t byte : SetUpBytes) {
    line_.SendByte(byte);
  }
  return line_.Await("f").End;
}

DownloadStep QvmRoute::SendLine(std::string_view digits) {
  // Events run again in the wait for the reply, so that the window is painted while the line is busy and not
  // while it idles. Until then less than a millisecond passes.
  Convert(digits);
  for (int errors = 0;;) {
    if (const DownloadStep end = SendBuffer()) {
      return end;
    }
    const DownloadReply reply = line_.AwaitReply();
    if (reply.End) {
      return reply.End;
    }
    if (reply.Character != 'f') {
      line_.NoteBadReply("line " + std::to_string(lineNumber_), reply.Character);
    }
    if (reply.Character == 'e') {
      return FirmwareEnd::InvalidLineAddress;
    }
    if (reply.Character != 'c') {
      return std::nullopt;  // devices of this kind accept a buffer by any other character too
    }
    if (errors >= MostErrorsOfALine) {
      return FirmwareEnd::TooManyErrors;
    }
    ++errors;
  }
}

void QvmRoute::Convert(std::string_view digits) {
  lineBytes_.clear();
  const ShownDigits shown(display_, digits);
  while (!digits.empty()) {
    const std::int16_t value = Hex_Convert(digits.substr(0, 2));
    if (lineBytes_.size() == QvmLines::MostBytesOfALine) {
      throw RuntimeError(Fault::SubscriptOutOfRange);
    }
    lineBytes_.push_back(value);
    RemovePair(digits);
  }
}

DownloadStep QvmRoute::SendBuffer() {
  if (const DownloadStep end = line_.SendString("Z")) {
    return end;
  }
  for (const std::int16_t value : lineBytes_) {
    line_.SendByte(ByteOf(value));
    if (const DownloadStep end = line_.Ended()) {
      return end;
    }
  }
  return std::nullopt;
}
