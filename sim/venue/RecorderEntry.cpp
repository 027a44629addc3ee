#include <chrono>
#include <optional>
#include <string>

#include "sim/recorder/RecorderReport.h"
#include "sim/recorder/SoundRecorder.h"
#include "sim/venue/Devices.h"

namespace sim {
namespace {

StartedDevice Start(const DeviceStart& start) {
  const DeviceOptions& options = start.Options;
  SoundRecorderSettings settings{.Kind = static_cast<RecorderKind>(options.Choice("kind")),
                                 .Failure = options.FailureAs<RecorderFailure>(),
                                 .FailurePlace = options.Place,
                                 .LinePace = start.LinePace,
                                 .EraseTime = std::chrono::milliseconds(options.Number("erase-time")),
                                 .Log = start.Log()};
  if (const std::optional<std::string> folder = options.File("folder")) {
    settings.Files.emplace(*folder);
  }
  auto recorder = std::make_unique<SoundRecorder>(std::move(settings));
  const auto obey = [&told = *recorder](const std::string& line) { return ObeyRecorderCommand(told, line); };
  return {std::move(recorder), obey};
}

}  // namespace

DeviceEntry RecorderEntry() {
  return {.Name = "recorder",
          .Title = "sound recorder",
          .Purpose = "the sound hardware of a gun (19200 baud) and the stand-alone recorder (115200)",
          .Failures = FailureRows(RecorderFailures),
          .NoSuchFailure = "The sound recorder has no failure",
          .PlaceMeaning = "the page of a recording or the answer that the failure affects, from 1 (1)",
          .Options = {{"kind", "KIND", "either, gun or stand-alone: which speeds it understands (either)",
                       ChoiceValue{{"either", "gun", "stand-alone"}}},
                      {"erase-time", "MS", "milliseconds that an erase takes (500)",
                       NumberValue{.Highest = 120'000, .Default = 500}},
                      {"folder", "DIR", "a folder for each recording: sounds as wave files, table and pages",
                       FileValue{}}},
          .Commands = {{"sounds", "list what the sound recorder holds"}},
          .Start = Start};
}

}  // namespace sim
