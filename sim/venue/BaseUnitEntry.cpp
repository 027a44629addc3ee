#include <optional>
#include <stdexcept>
#include <utility>

#include "sim/baseunit/BaseUnit.h"
#include "sim/venue/Devices.h"

namespace sim {
namespace {

// A later game can be too short for the byte at which the first one failed.
BaseUnitAnswer AnswerOfLaterGame(std::vector<GunScores> game, BaseUnitFailure failure, std::size_t place) {
  try {
    return MakeBaseUnitAnswer(game, failure, place);
  } catch (const std::invalid_argument&) {
    return MakeBaseUnitAnswer(std::move(game));
  }
}

StartedDevice Start(const DeviceStart& start) {
  const DeviceOptions& options = start.Options;
  const auto failure = options.FailureAs<BaseUnitFailure>();
  const auto nextAnswer = [next = start.NextGame, failure,
                           place = options.Place]() -> std::optional<BaseUnitAnswer> {
    std::optional<std::vector<GunScores>> game = next();
    return game ? std::optional(AnswerOfLaterGame(std::move(*game), failure, place)) : std::nullopt;
  };
  BaseUnitSettings settings{.Answer = MakeBaseUnitAnswer(start.Game, failure, options.Place),
                            .NextAnswer = nextAnswer,
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
