#include "firmware/pic24f/PicFrame.h"

#include <numeric>

namespace {

std::uint8_t SumOf(std::span<const std::uint8_t> bytes) {
  return static_cast<std::uint8_t>(std::accumulate(bytes.begin(), bytes.end(), 0U));
}

void Append(std::vector<std::uint8_t>& frame, std::uint8_t byte) {
  if (byte == PicMark::Stx || byte == PicMark::Etx || byte == PicMark::Dle) {
    frame.push_back(PicMark::Dle);
  }
  frame.push_back(byte);
}

}  // namespace

std::vector<std::uint8_t> PicFrame(std::span<const std::uint8_t> data) {
  std::vector<std::uint8_t> frame = {PicMark::Stx, PicMark::Stx};
  for (const std::uint8_t byte : data) {
    Append(frame, byte);
  }
  Append(frame, static_cast<std::uint8_t>(-SumOf(data)));
  frame.push_back(PicMark::Etx);
  return frame;
}

bool PicFrameDecoder::Receive(std::uint8_t byte) {
  if (state_ == State::Escaped) {
    state_ = State::Inside;
    Add(byte);
    return false;
  }
  if (byte == PicMark::Stx) {
    // More than two of them begin a packet as well; one in the midst of a packet begins the next.
    const bool isSecond = state_ == State::Begun || (state_ == State::Inside && bytes_.empty());
    state_ = isSecond ? State::Inside : State::Begun;
    bytes_.clear();
    return false;
  }
  if (state_ != State::Inside) {
    state_ = State::Outside;
    return false;
  }
  if (byte == PicMark::Etx) {
    state_ = State::Outside;
    return Complete();
  }
  if (byte == PicMark::Dle) {
    state_ = State::Escaped;
  } else {
    Add(byte);
  }
  return false;
}

void PicFrameDecoder::Add(std::uint8_t byte) {
  bytes_.push_back(byte);
  if (bytes_.size() > longest_ + 1) {
    state_ = State::Outside;
  }
}

bool PicFrameDecoder::Complete() {
  if (bytes_.size() < 2 || SumOf(bytes_) != 0) {
    return false;
  }
  bytes_.pop_back();
  data_.swap(bytes_);
  return true;
}
