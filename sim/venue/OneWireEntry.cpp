#include "sim/onewire/ButtonCommands.h"
#include "sim/onewire/OneWireAdapter.h"
#include "sim/venue/Devices.h"

namespace sim {
namespace {

StartedDevice Start(const DeviceStart& start) {
  auto adapter = std::make_unique<OneWireAdapter>(
      OneWireAdapterSettings{.Failure = start.Options.FailureAs<OneWireFailure>(),
                             .FailurePlace = start.Options.Place,
                             .LinePace = start.LinePace,
                             .Log = start.Log()});
  const auto obey = [&reader = *adapter](const std::string& line) { return ObeyButtonCommand(reader, line); };
  return {std::move(adapter), obey};
}

}  // namespace

DeviceEntry OneWireEntry() {
  return {.Name = "onewire",
          .Title = "1-wire adapter",
          .Purpose = "the reader of buttons, with the commands below",
          .Failures = FailureRows(OneWireFailures),
          .NoSuchFailure = "The 1-wire adapter has no failure",
          .PlaceMeaning = "the byte or bit that the failure affects, counted from 1 (1)",
          .Commands = {{"touch ID",
                        "hold a button to the reader: 16 hexadecimal digits, CRC first, family code last"},
                       {"leave ID", "take that button away"},
                       {"leave", "take all buttons away"},
                       {"fill ID CONTENT",
                        "give a button of family 06 or 08 an ammo-mag, bandage, blank, zeros, wrong-check or "
                        "unknown-kind"},
                       {"show ID", "print the charge block in the memory of a button"}},
          .Start = Start};
}

}  // namespace sim
