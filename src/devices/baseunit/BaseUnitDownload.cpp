#include "devices/baseunit/BaseUnitDownload.h"

#include <chrono>
#include <span>

#include "core/line/Checksum.h"

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
                                   MessageBoxes& boxes, const Clock& clock, DownloadProgress& progress,
                                   DownloadedGuns& guns)
    : commPort_(commPort),
      events_(events),
      boxes_(boxes),
      clock_(clock),
      progress_(progress),
      guns_(guns),
      job_(port, events, "base-unit", [&progress] { return progress.ClosedByOperator(); }) {}

DownloadResult BaseUnitDownload::GetScores() {
  guns_.Begin();
  progress_.Open();
  progress_.SetStatusText("Requesting Data...");
  const bool atEnd = commPort_.OpenCommPort(LineSettings) && Transfer();
  if (atEnd && result_.Received == result_.Expected) {
    result_.End = DownloadEnd::Complete;
    guns_.Settle();
  } else if (Stopped()) {
    result_.End = DownloadEnd::Stopped;
  }
  progress_.Close();
  job_.Close();
  return result_;
}

bool BaseUnitDownload::Transfer() {
  SendByte(1);
  job_.Pause(RequestPause);
  SendByte(0);
  const auto count = ReceiveByte();
  if (!count) {
    return false;
  }
  if (*count == 0) {
    progress_.Close();
    boxes_.Show("Kesh has no score data.", DefaultBoxTitle, BoxIcon::Information);
    return true;
  }
  result_.Expected = *count;
  progress_.SetMaximum(*count);
  for (int frame = 1; frame <= *count; ++frame) {
    progress_.SetStatusText("Accepting Score Data...");
    progress_.StartTransferAnim();
    progress_.SetProgress(frame);
    if (!ReceiveFrame()) {
      return false;
    }
    const auto crc = ReceiveByte();
    if (!crc) {
      return false;
    }
    if (ChecksumFits(*crc)) {
      AcceptFrame();
    } else {
      RejectFrame();
    }
  }
  return true;
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
  guns_.AnalyseData(buffer_, clock_);
  ++result_.Received;
  job_.Pause(ReplyPause);
  SendByte(FrameAccepted);
}

void BaseUnitDownload::RejectFrame() {
  job_.Pause(ReplyPause);
  SendByte(FrameRejected);
  if (job_.Fault()) {
    return;
  }
  boxes_.Show("Checksum failed", DefaultBoxTitle, BoxIcon::Critical);
  progress_.SetStatusText("Checksum failed!");
  events_.Sleep(RejectPause);
}

void BaseUnitDownload::SendByte(std::uint8_t byte) {
  if (!job_.Send(byte)) {
    TellOfFault();
  }
}

std::optional<std::uint8_t> BaseUnitDownload::ReceiveByte() {
  const auto [wait, byte] = job_.WaitForByte(ByteTimeLimit);
  switch (wait) {
    case LineWait::Met:
      return byte;
    case LineWait::TimedOut:
      boxes_.Show("Timed out waiting for Data. Please try again.", DefaultBoxTitle, BoxIcon::Exclamation);
      break;
    case LineWait::Fault:
      TellOfFault();
      break;
    case LineWait::Stopped:
      break;
  }
  return std::nullopt;
}

bool BaseUnitDownload::Stopped() const {
  // Only a command of ours closes the line; one that is lost stays open.
  return job_.Stopped() || (job_.Fault() && job_.Fault()->Error.Number() == Fault::PortNotOpen);
}

void BaseUnitDownload::TellOfFault() {
  if (Stopped()) {
    return;
  }
  if (const auto fault = job_.FaultToTell()) {
    boxes_.Show(fault->Sending ? "Error occured sending data. Please try again."
                               : "Error occured receiving data. Please try again.",
                DefaultBoxTitle, BoxIcon::Exclamation);
  }
}
