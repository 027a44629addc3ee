#include <chrono>
#include <sstream>
#include <stdexcept>

#include "sim/box/UtilityBox.h"
#include "sim/venue/Devices.h"

namespace sim {
namespace {

std::string Obey(const UtilityBox& box, const std::string& line) {
  std::istringstream words(line);
  std::string command;
  std::string rest;
  words >> command >> rest;
  if (command.empty()) {
    return {};
  }
  if (command != "told" || !rest.empty()) {
    throw std::invalid_argument("There is no command \"" + line + "\"");
  }
  const std::optional<BoxFrame> accepted = box.Traffic().Accepted;
  return accepted ? "told " + Describe(*accepted) : "told nothing";
}

StartedDevice Start(const DeviceStart& start) {
  const DeviceOptions& options = start.Options;
  auto box = std::make_unique<UtilityBox>(
      UtilityBoxSettings{.Failure = options.FailureAs<BoxFailure>(),
                         .FailurePlace = options.Place,
                         .Times = static_cast<int>(options.Number("times")),
                         .Late = std::chrono::milliseconds(options.Number("late")),
                         .LinePace = start.LinePace,
                         .Log = start.Log()});
  const auto obey = [&served = *box](const std::string& line) { return Obey(served, line); };
  return {std::move(box), obey};
}

}  // namespace

DeviceEntry BoxEntry() {
  return {.Name = "box",
          .Title = "utility box",
          .Purpose = "a utility box on its cable",
          .Failures = FailureRows(BoxFailures),
          .NoSuchFailure = "The utility box has no failure",
          .PlaceMeaning = "the byte of a frame that the failure affects, 1 to 10 (1)",
          .HighestPlace = 10,
          .Options = {{"times", "N", "how many frames the failure affects; 0: all (0)",
                       NumberValue{.Highest = 1'000'000}},
                      {"late", "MS", "milliseconds that a late answer takes (2500)",
                       NumberValue{.Highest = 60'000, .Default = 2500}}},
          .Commands = {{"told", "print the values that the box accepted last"}},
          .Start = Start};
}

}  // namespace sim
