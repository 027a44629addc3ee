#include <algorithm>
#include <chrono>
#include <string>
#include <string_view>
#include <vector>

#include "sim/pic24f/Pic24fCommands.h"
#include "sim/pic24f/Pic24fLoader.h"
#include "sim/venue/Devices.h"

namespace sim {
namespace {

std::vector<std::string_view> DeviceNames() {
  std::vector<std::string_view> names(Pic24fDevices.size());
  std::transform(Pic24fDevices.begin(), Pic24fDevices.end(), names.begin(),
                 [](const Pic24fDevice& device) { return device.Name; });
  return names;
}

// The chosen device with the figures that the command line gives for it.
Pic24fDevice DeviceOf(const DeviceOptions& options) {
  Pic24fDevice device = Pic24fDevices.at(options.Choice("device"));
  if (const std::uint64_t identity = options.Number("identity"); identity != 0) {
    device.Identity = static_cast<std::uint16_t>(identity);
  }
  if (const std::uint64_t pages = options.Number("pages"); pages != 0) {
    device.Instructions = static_cast<std::uint32_t>(pages * PageInstructions);
  }
  if (const std::uint64_t words = options.Number("eeprom-words"); words != 0) {
    device.EepromBytes = static_cast<std::uint32_t>(words * WordBytes);
  }
  device.UserResetVector = static_cast<std::uint32_t>(options.Number("user-reset"));
  device.BootDelay = static_cast<std::uint32_t>(options.Number("boot-delay"));
  return device;
}

StartedDevice Start(const DeviceStart& start) {
  const DeviceOptions& options = start.Options;
  auto loader = std::make_unique<Pic24fLoader>(
      Pic24fLoaderSettings{.Device = DeviceOf(options),
                           .Failure = options.FailureAs<Pic24fFailure>(),
                           .FailurePlace = options.Place,
                           .LinePace = start.LinePace,
                           .RowTime = std::chrono::milliseconds(options.Number("row-time")),
                           .PageTime = std::chrono::milliseconds(options.Number("page-time")),
                           .Log = start.Log()});
  const auto obey = [&served = *loader](const std::string& line) { return ObeyPic24fCommand(served, line); };
  return {std::move(loader), obey};
}

}  // namespace

DeviceEntry Pic24fEntry() {
  return {.Name = "pic24f",
          .Title = "PIC24F bootloader",
          .Purpose = "a device of type B in its bootloader, at any speed from 1200 to 115200 baud",
          .Failures = FailureRows(Pic24fFailures),
          .NoSuchFailure = "The PIC24F bootloader has no failure",
          .PlaceMeaning = "the request, answer or row that the failure affects, counted from 1 (1)",
          .Options =
              {{"device", "NAME", "medium, large or small: its memory (medium)", ChoiceValue{DeviceNames()}},
               {"identity", "N", "its identity; 0: 1001, 1002 or 1003 (0)", NumberValue{.Highest = 65'535}},
               {"pages", "N", "its pages of 512 instructions; 0: 86, 171 or 11 (0)",
                NumberValue{.Highest = 15'872}},
               {"eeprom-words", "N", "its words of EEPROM; 0: none, or 256 if small (0)",
                NumberValue{.Highest = 16'382}},
               {"user-reset", "N", "program address where the loader keeps the application's start (0: none)",
                NumberValue{.Highest = 0xFFFFFF}},
               {"boot-delay", "N", "program address where the loader keeps its delay (0: none)",
                NumberValue{.Highest = 0xFFFFFF}},
               {"row-time", "MS", "milliseconds to program a row (2)",
                NumberValue{.Highest = 10'000, .Default = 2}},
               {"page-time", "MS", "milliseconds to erase a page (20)",
                NumberValue{.Highest = 10'000, .Default = 20}}},
          .Commands = {{"reset", "back from the application to the bootloader"},
                       {"save FILE", "write the program memory, four bytes an instruction"}},
          .Start = Start};
}

}  // namespace sim
