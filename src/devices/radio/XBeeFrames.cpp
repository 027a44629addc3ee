#include "devices/radio/XBeeFrames.h"

#include <algorithm>
#include <cstddef>
#include <iterator>
#include <numeric>

namespace {

constexpr std::size_t HeadLength = 3;

/// Fills in the length and adds the check byte.
void Close(std::vector<std::uint8_t>& frame) {
  const std::size_t bodyLength = frame.size() - HeadLength;
  frame[1] = static_cast<std::uint8_t>(bodyLength >> 8);
  frame[2] = static_cast<std::uint8_t>(bodyLength);
  const auto sum = std::accumulate(frame.begin() + HeadLength, frame.end(), 0U);
  frame.push_back(static_cast<std::uint8_t>(255 - (sum & 255)));
}

}  // namespace

std::vector<std::uint8_t> TransmitRequest(const XBeeAddress& destination,
                                          std::span<const std::uint8_t> data) {
  constexpr std::uint8_t noStatusWanted = 0;
  constexpr std::uint8_t options = 0;
  std::vector<std::uint8_t> frame = {FrameStart, 0, 0, XBeeApi::Transmit64, noStatusWanted};
  std::copy(destination.rbegin(), destination.rend(), std::back_inserter(frame));
  frame.push_back(options);
  std::copy(data.begin(), data.end(), std::back_inserter(frame));
  Close(frame);
  return frame;
}

std::vector<std::uint8_t> AtCommandFrame(std::uint8_t frameId, const AtLetters& letters,
                                         std::span<const std::uint8_t> value) {
  std::vector<std::uint8_t> frame = {FrameStart, 0, 0, XBeeApi::AtCommand, frameId, letters[0], letters[1]};
  std::copy(value.begin(), value.end(), std::back_inserter(frame));
  Close(frame);
  return frame;
}
