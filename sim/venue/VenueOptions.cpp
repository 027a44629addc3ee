#include "sim/venue/VenueOptions.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <iomanip>
#include <limits>
#include <sstream>
#include <stdexcept>
#include <string_view>

namespace sim {
namespace {

template <class T>
T ParseNumber(const std::string& option, const std::string& text, T highest) {
  T value{};
  const char* end = text.data() + text.size();
  const std::from_chars_result result = std::from_chars(text.data(), end, value);
  if (result.ec != std::errc() || result.ptr != end || value < T{0} || value > highest) {
    throw std::invalid_argument(option + " wants a number from 0 to " + std::to_string(highest) + ", not \"" +
                                text + "\"");
  }
  return value;
}

BaseUnitFailure ParseFailure(const std::string& name) {
  const auto* info =
      std::find_if(BaseUnitFailures.begin(), BaseUnitFailures.end(),
                   [&](const BaseUnitFailureInfo& candidate) { return candidate.Name == name; });
  if (info == BaseUnitFailures.end()) {
    throw std::invalid_argument("There is no failure \"" + name + "\"");
  }
  return info->Failure;
}

OneWireFailure ParseOneWireFailure(const std::string& name) {
  const auto* info =
      std::find_if(OneWireFailures.begin(), OneWireFailures.end(),
                   [&](const OneWireFailureInfo& candidate) { return candidate.Name == name; });
  if (info == OneWireFailures.end()) {
    throw std::invalid_argument("The 1-wire adapter has no failure \"" + name + "\"");
  }
  return info->Failure;
}

RadioFailure ParseRadioFailure(const std::string& name) {
  const auto* info = std::find_if(RadioFailures.begin(), RadioFailures.end(),
                                  [&](const RadioFailureInfo& candidate) { return candidate.Name == name; });
  if (info == RadioFailures.end()) {
    throw std::invalid_argument("The radio has no failure \"" + name + "\"");
  }
  return info->Failure;
}

std::string ParseFile(const std::string& option, const std::string& text) {
  if (text.empty()) {
    throw std::invalid_argument(option + " wants a file name");
  }
  return text;
}

struct ValueOption {
  std::string_view Name;
  void (*Take)(VenueOptions& options, const std::string& name, const std::string& value);
};

constexpr std::array<ValueOption, 17> valueOptions{{
    {"--players", [](VenueOptions& options, const std::string& name,
                     const std::string& value) { options.Players = ParseNumber(name, value, 224); }},
    {"--seed",
     [](VenueOptions& options, const std::string& name, const std::string& value) {
       options.Seed = ParseNumber(name, value, std::numeric_limits<std::uint32_t>::max());
     }},
    {"--failure", [](VenueOptions& options, const std::string&,
                     const std::string& value) { options.Failure = ParseFailure(value); }},
    {"--at",
     [](VenueOptions& options, const std::string& name, const std::string& value) {
       options.FailurePlace = ParseNumber(name, value, std::size_t{1'000'000});
     }},
    {"--games", [](VenueOptions& options, const std::string& name,
                   const std::string& value) { options.Games = ParseNumber(name, value, 1'000'000); }},
    {"--log", [](VenueOptions& options, const std::string& name,
                 const std::string& value) { options.LogFile = ParseFile(name, value); }},
    {"--frames", [](VenueOptions& options, const std::string& name,
                    const std::string& value) { options.FramesFile = ParseFile(name, value); }},
    {"--link", [](VenueOptions& options, const std::string& name,
                  const std::string& value) { options.Link = ParseFile(name, value); }},
    {"--onewire-failure",
     [](VenueOptions& options, const std::string&, const std::string& value) {
       options.AdapterFailure = ParseOneWireFailure(value);
     }},
    {"--onewire-at",
     [](VenueOptions& options, const std::string& name, const std::string& value) {
       options.AdapterFailurePlace = ParseNumber(name, value, std::size_t{1'000'000});
     }},
    {"--onewire-link", [](VenueOptions& options, const std::string& name,
                          const std::string& value) { options.AdapterLink = ParseFile(name, value); }},
    {"--radio-failure",
     [](VenueOptions& options, const std::string&, const std::string& value) {
       options.RadioTrouble.Failure = ParseRadioFailure(value);
     }},
    {"--radio-at",
     [](VenueOptions& options, const std::string& name, const std::string& value) {
       options.RadioTrouble.Gun = ParseNumber(name, value, std::size_t{224});
     }},
    {"--radio-times",
     [](VenueOptions& options, const std::string& name, const std::string& value) {
       options.RadioTrouble.Times = ParseNumber(name, value, 1'000'000);
     }},
    {"--radio-answer-time",
     [](VenueOptions& options, const std::string& name, const std::string& value) {
       options.RadioAnswerTime = std::chrono::milliseconds(ParseNumber(name, value, 10'000));
     }},
    {"--radio-frames", [](VenueOptions& options, const std::string& name,
                          const std::string& value) { options.RadioFramesFile = ParseFile(name, value); }},
    {"--radio-link", [](VenueOptions& options, const std::string& name,
                        const std::string& value) { options.RadioLink = ParseFile(name, value); }},
}};

}  // namespace

VenueOptions ParseVenueOptions(const std::vector<std::string>& arguments) {
  VenueOptions options;
  for (auto argument = arguments.begin(); argument != arguments.end(); ++argument) {
    const std::string& name = *argument;
    const auto* valueOption =
        std::find_if(valueOptions.begin(), valueOptions.end(),
                     [&](const ValueOption& candidate) { return candidate.Name == name; });
    if (name == "--fast") {
      options.Fast = true;
    } else if (name == "--onewire") {
      options.OneWire = true;
    } else if (name == "--radio") {
      options.Radio = true;
    } else if (name == "--until-eof") {
      options.UntilEof = true;
    } else if (name == "--help") {
      options.Help = true;
    } else if (valueOption == valueOptions.end()) {
      throw std::invalid_argument("There is no option \"" + name + "\"");
    } else if (++argument == arguments.end()) {
      throw std::invalid_argument(name + " wants a value");
    } else {
      valueOption->Take(options, name, *argument);
    }
  }
  return options;
}

std::string VenueUsage() {
  std::ostringstream text;
  text << "Usage: tessarine-venue [OPTION]...\n"
          "Stands in for the devices of a venue, each on a pseudo terminal of its own. Prints \"base unit: "
          "DEVICE\" when\n"
          "it is ready and serves until SIGTERM or SIGINT.\n\n"
          "  --players N     guns in the game, 0 to 224 (40)\n"
          "  --seed S        picks the game; a seed always gives the same game (1)\n"
          "  --fast          bytes as fast as possible instead of at the line's speed\n"
          "  --failure NAME  what goes wrong in every answer, see below (none)\n"
          "  --at K          the frame or byte of the answer that the failure concerns, from 1 (1)\n"
          "  --log FILE      what passes the line: seconds, device, -> to or <- from the host, bytes\n"
          "  --frames FILE   the frames exactly as put on the line, one after the other\n"
          "  --link PATH     a symbolic link to the base unit's device, removed at the end\n"
          "  --games N       end after N requests; 0: never (0)\n"
          "  --onewire       serve the reader of membership buttons too; prints \"1-wire adapter: DEVICE\" "
          "and "
          "obeys\n"
          "                  the commands below on the standard input\n"
          "  --onewire-link PATH     as --link, to the reader's device\n"
          "  --onewire-failure NAME  what goes wrong at the reader, see below (none)\n"
          "  --onewire-at K          the byte or bit that its failure concerns, from 1 (1)\n"
          "  --radio         serve the radio modem and the guns too; prints \"radio modem: DEVICE\"; tells "
          "at\n"
          "                  the end on the standard error what the host must not have sent\n"
          "  --radio-link PATH       as --link, to the radio modem's device\n"
          "  --radio-frames FILE     as --frames, a gun's frame when the host first closes its transfer\n"
          "  --radio-failure NAME    what goes wrong by radio, see below (none)\n"
          "  --radio-at K            the gun that it strikes, from 1 by player ids; 0: every gun (1)\n"
          "  --radio-times N         how many of a gun's answers it strikes; 0: all (0)\n"
          "  --radio-answer-time MS  milliseconds in which a gun answers (5)\n"
          "  --until-eof     end when the standard input ends\n"
          "  --help          this text\n\n"
          "Failures:\n";
  for (const BaseUnitFailureInfo& info : BaseUnitFailures) {
    text << "  " << std::left << std::setw(25) << info.Name << info.Meaning << '\n';
  }
  text << "\nFailures at the reader of membership buttons:\n";
  for (const OneWireFailureInfo& info : OneWireFailures) {
    text << "  " << std::left << std::setw(25) << info.Name << info.Meaning << '\n';
  }
  text << "\nFailures by radio:\n";
  for (const RadioFailureInfo& info : RadioFailures) {
    text << "  " << std::left << std::setw(25) << info.Name << info.Meaning << '\n';
  }
  text << "\nCommands:\n"
          "  touch ID   hold a button to the reader: 16 hexadecimal digits, CRC first, family code last\n"
          "  leave ID   take it away\n"
          "  leave      take all buttons away\n";
  return text.str();
}

}  // namespace sim
