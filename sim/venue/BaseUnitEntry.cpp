#include "sim/baseunit/BaseUnit.h"
#include "sim/venue/Devices.h"

namespace sim {
namespace {

StartedDevice Start(const DeviceStart& start) {
  const DeviceOptions& options = start.Options;
  BaseUnitSettings settings{
      .Answer = MakeBaseUnitAnswer(start.Game, options.FailureAs<BaseUnitFailure>(), options.Place),
      .LinePace = start.LinePace,
      .Requests = static_cast<int>(options.Number("games")),
      .Log = start.Log(),
      .Frames = start.File("frames"),
      .OnFinished = start.EndVenue};
  return {std::make_unique<BaseUnit>(std::move(settings))};
}

}  // namespace

DeviceEntry BaseUnitEntry() {
  return {.Name = "base-unit",
          .Title = "base unit",
          .Purpose = "the unit that hands over the scores of a game",
          .ServedUnlessTold = true,
          .PlainOptions = true,
          .Failures = FailureRows(BaseUnitFailures),
          .NoSuchFailure = "There is no failure",
          .PlaceMeaning = "the frame or byte of the answer that the failure affects, counted from 1 (1)",
          .Options = {{"frames", "FILE", "the frames, one after the other, exactly as put on the line",
                       FileValue{}},
                      {"games", "N", "end the program after N requests; 0: never (0)",
                       NumberValue{.Highest = 1'000'000}}},
          .Start = Start};
}

}  // namespace sim
