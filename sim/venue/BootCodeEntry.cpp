#include <chrono>

#include "sim/bootcode/BootCode.h"
#include "sim/bootcode/BootCommands.h"
#include "sim/venue/Devices.h"

namespace sim {
namespace {

StartedDevice Start(const DeviceStart& start) {
  const DeviceOptions& options = start.Options;
  const std::chrono::milliseconds powerOn(options.Number("power-on"));
  BootCodeSettings settings{.Product = options.Choice("product") == 0 ? BootProduct::Qvm2 : BootProduct::Qvm,
                            .FlashFile = options.File("flash"),
                            .Trouble = {.Failure = options.FailureAs<BootFailure>(), .Place = options.Place},
                            .Runs = options.Number("runs"),
                            .Times = options.Number("times"),
                            .Late = std::chrono::milliseconds(options.Number("late")),
                            .Gap = std::chrono::milliseconds(options.Number("gap")),
                            .LinePace = start.LinePace,
                            .Log = start.Log()};
  if (powerOn.count() > 0) {
    settings.PowerOnAfterOpening = powerOn;
  }
  auto device = std::make_unique<BootCode>(std::move(settings));
  const auto obey = [&served = *device](const std::string& line) { return ObeyBootCommand(served, line); };
  return {std::move(device), obey};
}

}  // namespace

DeviceEntry BootCodeEntry() {
  return {.Name = "bootcode",
          .Title = "boot code",
          .Purpose = "a device that takes new firmware, with the command below",
          .Failures = FailureRows(BootFailures),
          .NoSuchFailure = "The boot code has no failure",
          .PlaceMeaning = "the reply or packet that the failure affects, counted from 1 (1)",
          .Options = {{"product", "KIND", "qvm2 or qvm: which firmware files it takes (qvm2)",
                       ChoiceValue{{"qvm2", "qvm"}}},
                      {"flash", "FILE",
                       "keeps what was loaded: 786432 bytes of a qvm2 product, lines of a qvm product",
                       FileValue{}},
                      {"power-on", "MS",
                       "switched on MS milliseconds after a host opened the line; 0: on command only (0)",
                       NumberValue{.Highest = 600'000}},
                      {"runs", "N", "how often, when it is switched on, the failure comes; 0: each time (0)",
                       NumberValue{.Highest = 1'000'000}},
                      {"times", "N", "how many packets in a row are asked for again (1)",
                       NumberValue{.Highest = 1'000'000, .Default = 1}},
                      {"late", "MS", "milliseconds that a late reply takes (12000)",
                       NumberValue{.Highest = 60'000, .Default = 12'000}},
                      {"gap", "MS", "milliseconds of quiet that end a buffer of a qvm product (50)",
                       NumberValue{.Highest = 10'000, .Default = 50}}},
          .Commands = {{"power", "switch the device off and on: it says BOOT"},
                       {"power FAILURE K", "the same, with this failure until it is switched on again"}},
          .Start = Start};
}

}  // namespace sim
