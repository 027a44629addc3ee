#include "devices/baseunit/BaseUnitDownload.h"

#include <chrono>
#include <span>

#include "core/line/Checksum.h"
#include "platform/RuntimeError.h"

using std::chrono::milliseconds;

namespace {

constexpr std::uint8_t FrameAccepted = 170;
constexpr std::uint8_t FrameRejected = 0;
constexpr milliseconds ByteTimeLimit{5000};
constexpr milliseconds RequestPause{20};
constexpr milliseconds ReplyPause{50};
constexpr milliseconds RejectPause{2000};

}  // namespace

BaseUnitDownload::BaseUnitDownload(SerialPort& port, CommPort& commPort, EventPump& events,
                                   MessageBoxes& boxes, const Clock& clock, TransferProgress& progress,
                                   Game& game)
    : port_(port),
      commPort_(commPort),
      events_(events),
      boxes_(boxes),
      clock_(clock),
      progress_(progress),
      game_(game) {}

void BaseUnitDownload::GetScores() {
  progress_.Open();
  progress_.SetStatusText("Requesting Data...");
  if (commPort_.OpenCommPort(LineSettings)) {
    Transfer();
  }
  progress_.Close();
  commPort_.CloseIfOpen();
}

void BaseUnitDownload::Transfer() {
  SendByte(1);
  events_.Sleep(RequestPause);
  SendByte(0);
  const auto count = ReceiveByte();
  if (!count) {
    return;
  }
  if (*count == 0) {
    progress_.Close();
    boxes_.Show("Kesh has no score data.", DefaultBoxTitle, BoxIcon::Information);
    return;
  }
  progress_.SetMaximum(*count);
  for (int frame = 1; frame <= *count; ++frame) {
    progress_.SetStatusText("Accepting Score Data...");
    progress_.StartTransferAnim();
    progress_.SetProgress(frame);
    if (!ReceiveFrame()) {
      return;
    }
    const auto crc = ReceiveByte();
    if (!crc) {
      return;
    }
    if (ChecksumFits(*crc)) {
      AcceptFrame();
    } else {
      RejectFrame();
    }
  }
}

bool BaseUnitDownload::ReceiveFrame() {
  const auto low = ReceiveByte();
  const auto high = low ? ReceiveByte() : std::nullopt;
  if (!high) {
    return false;
  }
  length_ = static_cast<std::size_t>(MakeWord(*high, *low).value_or(0));
  buffer_[0] = *low;
  buffer_[1] = *high;
  for (std::size_t offset = 2; offset < length_; ++offset) {
    const auto byte = ReceiveByte();
    if (!byte) {
      return false;
    }
    if (offset < buffer_.size()) {
      buffer_[offset] = *byte;
    }
  }
  return true;
}

bool BaseUnitDownload::ChecksumFits(std::uint8_t crc) const {
  return length_ <= buffer_.size() && Crc8(std::span(buffer_).first(length_)) == crc;
}

void BaseUnitDownload::AcceptFrame() {
  AnalyseData(buffer_, game_, clock_);
  events_.Sleep(ReplyPause);
  SendByte(FrameAccepted);
}

void BaseUnitDownload::RejectFrame() {
  events_.Sleep(ReplyPause);
  SendByte(FrameRejected);
  if (lineLost_) {
    return;
  }
  boxes_.Show("Checksum failed", DefaultBoxTitle, BoxIcon::Critical);
  progress_.SetStatusText("Checksum failed!");
  events_.Sleep(RejectPause);
}

void BaseUnitDownload::SendByte(std::uint8_t byte) {
  if (lineLost_) {
    return;
  }
  try {
    port_.Output(byte);
  } catch (const RuntimeError&) {
    ReportLostLine("Error occured sending data. Please try again.");
  }
}

std::optional<std::uint8_t> BaseUnitDownload::ReceiveByte() {
  if (lineLost_) {
    return std::nullopt;
  }
  try {
    const WaitResult result = events_.WaitFor(
        [this] { return progress_.ClosedByOperator() || port_.InBufferCount() >= 1; }, ByteTimeLimit);
    if (result == WaitResult::Ended || progress_.ClosedByOperator()) {
      return std::nullopt;
    }
    if (result == WaitResult::Met) {
      return port_.Input();
    }
  } catch (const RuntimeError&) {
    ReportLostLine("Error occured receiving data. Please try again.");
    return std::nullopt;
  }
  boxes_.Show("Timed out waiting for Data. Please try again.", DefaultBoxTitle, BoxIcon::Exclamation);
  return std::nullopt;
}

void BaseUnitDownload::ReportLostLine(const std::string& text) {
  lineLost_ = true;
  boxes_.Show(text, DefaultBoxTitle, BoxIcon::Exclamation);
}
