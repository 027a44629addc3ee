#include "devices/box/BoxFrame.h"

#include "core/game/Game.h"
#include "core/text/NumberForms.h"
#include "platform/RuntimeError.h"

namespace {

/// Neither list can be without a choice while the operator uses it, but a program that presses the button can
/// take it away.
unsigned int Code(int index, std::size_t count) {
  if (index < 0 || static_cast<std::size_t>(index) >= count) {
    throw RuntimeError(Fault::Overflow);
  }
  return static_cast<unsigned int>(index);
}

}  // namespace

std::array<std::uint8_t, 10> BoxFrame(const BoxEntries& entries) {
  const unsigned int team = Code(entries.TeamList, TeamCount + 1);
  const unsigned int type = Code(entries.BoxType, BoxTypes.size());
  return {'B',
          'C',
          static_cast<std::uint8_t>(team * 16 + type),
          ToByte(entries.PointsPerAct),
          ToByte(entries.RechargePoints),
          ToByte(entries.ActivationAmount),
          ToByte(entries.AutoModeTime),
          entries.Destroyable ? std::uint8_t{1} : std::uint8_t{0},
          0,
          0};
}
