#include <chrono>
#include <optional>

#include "sim/radio/RadioGun.h"
#include "sim/radio/RadioModem.h"
#include "sim/venue/Devices.h"

namespace sim {
namespace {

StartedDevice Start(const DeviceStart& start) {
  const DeviceOptions& options = start.Options;
  const std::chrono::milliseconds answerTime(options.Number("answer-time"));
  const auto nextGuns = [next = start.NextGame, answerTime]() -> std::optional<std::vector<RadioGun>> {
    const std::optional<std::vector<GunScores>> game = next();
    return game ? std::optional(MakeRadioGuns(*game, answerTime)) : std::nullopt;
  };
  return {std::make_unique<RadioModem>(
      RadioModemSettings{.Guns = MakeRadioGuns(start.Game, answerTime),
                         .NextGuns = nextGuns,
                         .Trouble = {.Failure = options.FailureAs<RadioFailure>(),
                                     .Gun = options.Place,
                                     .Times = static_cast<int>(options.Number("times"))},
                         .LinePace = start.LinePace,
                         .Log = start.Log(),
                         .Frames = start.File("frames")})};
}

}  // namespace

DeviceEntry RadioEntry() {
  return {.Name = "radio",
          .Title = "radio modem",
          .Purpose = "the radio modem and the guns of the game",
          .Failures = FailureRows(RadioFailures),
          .NoSuchFailure = "The radio has no failure",
          .PlaceMeaning = "the gun that the failure affects, counted from 1 by player id; 0: every gun (1)",
          .HighestPlace = 224,
          .Options = {{"times", "N", "how many of a gun's answers the failure affects; 0: all (0)",
                       NumberValue{.Highest = 1'000'000}},
                      {"answer-time", "MS", "milliseconds that a gun takes to answer (5)",
                       NumberValue{.Highest = 10'000, .Default = 5}},
                      {"frames", "FILE", "each gun's frame, written when its transfer is first closed",
                       FileValue{}}},
          .FaultCount = TellFaultCount::Always,
          .Start = Start};
}

}  // namespace sim
