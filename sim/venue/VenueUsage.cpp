#include "sim/venue/VenueUsage.h"

#include <algorithm>
#include <iomanip>
#include <sstream>
#include <string_view>

#include "sim/venue/CommandLine.h"

namespace sim {
namespace {

void Row(std::ostream& text, const std::string& head, std::string_view meaning) {
  constexpr int column = 27;
  text << "  " << std::left << std::setw(column) << head;
  if (head.size() >= column) {
    text << "\n  " << std::setw(column) << "";
  }
  text << meaning << '\n';
}

void Rows(std::ostream& text, const std::vector<CommandLineOption>& options) {
  for (const CommandLineOption& option : options) {
    const std::string& head = option.Spellings.front();
    Row(text, option.Value.empty() ? head : head + ' ' + option.Value, option.Meaning);
  }
}

void Failures(std::ostream& text, const DeviceEntry& entry) {
  if (!entry.Failures.empty()) {
    text << "\nFailures of the " << entry.Title << ":\n";
    for (const FailureRow& failure : entry.Failures) {
      Row(text, std::string(failure.Name), failure.Meaning);
    }
  }
}

void Commands(std::ostream& text, const std::vector<DeviceEntry>& devices) {
  text << "\nCommands, one per line; the device's name may come first (\"onewire leave\"):\n";
  for (const DeviceEntry& entry : devices) {
    for (const DeviceCommand& command : entry.Commands) {
      Row(text, std::string(command.Usage), command.Meaning);
    }
  }
}

}  // namespace

std::string VenueUsage(const std::vector<DeviceEntry>& devices) {
  std::ostringstream text;
  text << "Usage: tessarine-venue [OPTION]...\n"
          "Stands in for the devices of a venue, each on its own pseudo terminal. Prints a line for each\n"
          "device when it is ready (\"base unit: DEVICE\"), obeys commands on the standard input, serves\n"
          "until SIGTERM or SIGINT, and at the end reports on the standard error what the host did wrong.\n"
          "A host whose line differs from the device's in speed, parity or number of bits gets no answer;\n"
          "seven data bits and even parity cannot be seen on a pseudo terminal.\n\n";
  Rows(text, GeneralOptions());
  for (const DeviceEntry& entry : devices) {
    text << "\nThe " << entry.Title;
    if (entry.PlainOptions) {
      text << " (--" << entry.Name << "-link and so on are other spellings)";
    }
    text << ":\n";
    Rows(text, OptionsOf(entry));
  }
  for (const DeviceEntry& entry : devices) {
    Failures(text, entry);
  }
  if (std::any_of(devices.begin(), devices.end(),
                  [](const DeviceEntry& entry) { return !entry.Commands.empty(); })) {
    Commands(text, devices);
  }
  return text.str();
}

}  // namespace sim
