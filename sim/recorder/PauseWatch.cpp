#include "sim/recorder/PauseWatch.h"

#include <string_view>

namespace sim {
namespace {

struct PauseInfo {
  std::chrono::milliseconds Due;
  std::string_view Fault;
};

// In the order of the enumeration.
constexpr std::array<PauseInfo, 7> Pauses{{
    {std::chrono::milliseconds(10), "leaves less than 10 ms between the bytes of a command"},
    {std::chrono::milliseconds(20), "leaves less than 20 ms before the page count"},
    {std::chrono::milliseconds(20), "leaves less than 20 ms in the page count"},
    {std::chrono::milliseconds(20), "leaves less than 20 ms before a page or header"},
    {std::chrono::milliseconds(255), "leaves less than 1 ms between the bytes of a page"},
    {std::chrono::milliseconds(20), "leaves less than 20 ms before the check byte"},
    {std::chrono::milliseconds(1000), "leaves less than 1 s between two sounds"},
}};

const PauseInfo& InfoOf(RecorderPause pause) {
  return Pauses.at(static_cast<std::size_t>(pause));
}

}  // namespace

std::optional<std::string> PauseWatch::See(RecorderPause pause, std::chrono::nanoseconds length) {
  constexpr std::size_t enough = 3;
  Count& count = counts_.at(static_cast<std::size_t>(pause));
  ++count.Seen;
  if (length < Due(pause) * 3 / 4) {
    ++count.Short;
  }
  if (count.Told || count.Short < enough || 2 * count.Short <= count.Seen) {
    return std::nullopt;
  }
  count.Told = true;
  return std::string(InfoOf(pause).Fault);
}

std::chrono::milliseconds PauseWatch::Due(RecorderPause pause) {
  return InfoOf(pause).Due;
}

}  // namespace sim
