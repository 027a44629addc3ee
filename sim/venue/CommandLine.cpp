#include "sim/venue/CommandLine.h"

#include <algorithm>
#include <charconv>
#include <chrono>
#include <limits>
#include <stdexcept>
#include <utility>

namespace sim {
namespace {

constexpr std::uint64_t LongestGameSeconds = 86'400;

std::uint64_t ParseNumber(const std::string& option, const std::string& text, std::uint64_t highest) {
  std::uint64_t value = 0;
  const char* end = text.data() + text.size();
  const std::from_chars_result result = std::from_chars(text.data(), end, value);
  if (result.ec != std::errc() || result.ptr != end || value > highest) {
    throw std::invalid_argument(option + " wants a number from 0 to " + std::to_string(highest) + ", not \"" +
                                text + "\"");
  }
  return value;
}

std::string ParseFile(const std::string& option, const std::string& text) {
  if (text.empty()) {
    throw std::invalid_argument(option + " wants a file name");
  }
  return text;
}

std::size_t ParseChoice(const std::string& option, const std::string& text,
                        const std::vector<std::string_view>& names) {
  const auto found = std::find(names.begin(), names.end(), text);
  if (found == names.end()) {
    std::string all;
    for (const std::string_view name : names) {
      all += (all.empty() ? "" : " or ") + std::string(name);
    }
    throw std::invalid_argument(option + " wants " + all + ", not \"" + text + "\"");
  }
  return static_cast<std::size_t>(found - names.begin());
}

std::size_t ParseFailure(const std::vector<FailureRow>& failures, std::string_view noSuchFailure,
                         const std::string& text) {
  const auto found = std::find_if(failures.begin(), failures.end(),
                                  [&](const FailureRow& candidate) { return candidate.Name == text; });
  if (found == failures.end()) {
    throw std::invalid_argument(std::string(noSuchFailure) + " \"" + text + "\"");
  }
  return static_cast<std::size_t>(found - failures.begin());
}

// Makes the options of one device.
class OptionMaker {
 public:
  explicit OptionMaker(const DeviceEntry& entry) : entry_(entry), name_(entry.Name) {}

  CommandLineOption Serve() const {
    return {
        {"--" + name_},
        "",
        "serve " + std::string(entry_.Purpose) + (entry_.ServedUnlessTold ? "; on unless switched off" : ""),
        [name = name_](VenueOptions& options, const std::string&, const std::string&) {
          options.Devices[name].Served = true;
        }};
  }

  CommandLineOption ServeNot() const {
    return {{"--no-" + name_},
            "",
            "do not serve it",
            [name = name_](VenueOptions& options, const std::string&, const std::string&) {
              options.Devices[name].Served = false;
            }};
  }

  CommandLineOption Link() const {
    return Make("link", "PATH", "a symbolic link to its device, removed at the end",
                [](DeviceOptions& device, const std::string& spelling, const std::string& value) {
                  device.Link = ParseFile(spelling, value);
                });
  }

  CommandLineOption Failure() const {
    return Make("failure", "NAME", "what goes wrong with it, see below (none)",
                [failures = entry_.Failures, noSuchFailure = entry_.NoSuchFailure](
                    DeviceOptions& device, const std::string&, const std::string& value) {
                  device.Failure = ParseFailure(failures, noSuchFailure, value);
                });
  }

  CommandLineOption Place() const {
    return Make("at", "K", entry_.PlaceMeaning,
                [highest = entry_.HighestPlace](DeviceOptions& device, const std::string& spelling,
                                                const std::string& value) {
                  device.Place = static_cast<std::size_t>(ParseNumber(spelling, value, highest));
                });
  }

  CommandLineOption Own(const DeviceOption& option) const {
    return Make(option.Name, option.Value, option.Meaning,
                [key = std::string(option.Name), kind = option.Kind](
                    DeviceOptions& device, const std::string& spelling, const std::string& value) {
                  if (const auto* number = std::get_if<NumberValue>(&kind)) {
                    device.Numbers[key] = ParseNumber(spelling, value, number->Highest);
                  } else if (const auto* choice = std::get_if<ChoiceValue>(&kind)) {
                    device.Numbers[key] = ParseChoice(spelling, value, choice->Names);
                  } else {
                    device.Files[key] = ParseFile(spelling, value);
                  }
                });
  }

 private:
  using Taker = std::function<void(DeviceOptions&, const std::string& spelling, const std::string& value)>;

  CommandLineOption Make(std::string_view option, std::string_view value, std::string_view meaning,
                         Taker take) const {
    std::vector<std::string> spellings;
    if (entry_.PlainOptions) {
      spellings.push_back("--" + std::string(option));
    }
    spellings.push_back("--" + name_ + '-' + std::string(option));
    return {std::move(spellings), std::string(value), std::string(meaning),
            [name = name_, take = std::move(take)](VenueOptions& options, const std::string& spelling,
                                                   const std::string& text) {
              take(options.Devices[name], spelling, text);
            }};
  }

  const DeviceEntry& entry_;
  std::string name_;
};

using Argument = const std::string&;

}  // namespace

std::vector<CommandLineOption> GeneralOptions() {
  return {
      {{"--players"},
       "N",
       "guns in the game, 0 to 224 (40)",
       [](VenueOptions& options, Argument spelling, Argument value) {
         options.Players = static_cast<int>(ParseNumber(spelling, value, 224));
       }},
      {{"--seed"},
       "S",
       "selects the game; a seed always gives the same game (1)",
       [](VenueOptions& options, Argument spelling, Argument value) {
         options.Seed = static_cast<std::uint32_t>(
             ParseNumber(spelling, value, std::numeric_limits<std::uint32_t>::max()));
       }},
      {{"--evening"},
       "SECONDS",
       "play an evening: a new game every SECONDS, told as \"game N\"; 0: one game (0)",
       [](VenueOptions& options, Argument spelling, Argument value) {
         options.Evening = std::chrono::seconds(ParseNumber(spelling, value, LongestGameSeconds));
       }},
      {{"--fast"},
       "",
       "send bytes as fast as possible instead of at the line's speed",
       [](VenueOptions& options, Argument, Argument) { options.Fast = true; }},
      {{"--log"},
       "FILE",
       "the traffic on the lines: seconds, device, -> to or <- from the host, bytes",
       [](VenueOptions& options, Argument spelling, Argument value) {
         options.LogFile = ParseFile(spelling, value);
       }},
      {{"--until-eof"},
       "",
       "end when the standard input ends",
       [](VenueOptions& options, Argument, Argument) { options.UntilEof = true; }},
      {{"--help"}, "", "this text", [](VenueOptions& options, Argument, Argument) { options.Help = true; }}};
}

std::vector<CommandLineOption> OptionsOf(const DeviceEntry& entry) {
  const OptionMaker maker(entry);
  std::vector<CommandLineOption> options{maker.Serve()};
  if (entry.ServedUnlessTold) {
    options.push_back(maker.ServeNot());
  }
  options.push_back(maker.Link());
  if (!entry.Failures.empty()) {
    options.push_back(maker.Failure());
    options.push_back(maker.Place());
  }
  for (const DeviceOption& own : entry.Options) {
    options.push_back(maker.Own(own));
  }
  return options;
}

}  // namespace sim
