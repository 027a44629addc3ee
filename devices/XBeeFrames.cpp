#include "devices/XBeeFrames.h"

#include <numeric>

namespace {

std::vector<std::uint8_t> Framed(const std::vector<std::uint8_t>& body) {
  std::vector<std::uint8_t> frame = {FrameStart, static_cast<std::uint8_t>(body.size() >> 8),
                                     static_cast<std::uint8_t>(body.size())};
  frame.insert(frame.end(), body.begin(), body.end());
  const auto sum = std::accumulate(body.begin(), body.end(), 0U);
  frame.push_back(static_cast<std::uint8_t>(255 - (sum & 255)));
  return frame;
}

}  // namespace

std::vector<std::uint8_t> TransmitRequest(const XBeeAddress& destination,
                                          std::span<const std::uint8_t> data) {
  constexpr std::uint8_t noStatusWanted = 0;
  constexpr std::uint8_t options = 0;
  std::vector<std::uint8_t> body = {XBeeApi::Transmit64, noStatusWanted};
  body.insert(body.end(), destination.rbegin(), destination.rend());
  body.push_back(options);
  body.insert(body.end(), data.begin(), data.end());
  return Framed(body);
}

std::vector<std::uint8_t> AtCommandFrame(std::uint8_t frameId, const AtLetters& letters,
                                         std::span<const std::uint8_t> value) {
  std::vector<std::uint8_t> body = {XBeeApi::AtCommand, frameId, letters[0], letters[1]};
  body.insert(body.end(), value.begin(), value.end());
  return Framed(body);
}
