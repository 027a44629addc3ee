#include "sim/onewire/ButtonCommands.h"

#include <sstream>
#include <stdexcept>

namespace sim {

std::string ObeyButtonCommand(OneWireAdapter& adapter, const std::string& line) {
  std::istringstream words(line);
  std::string command;
  std::string button;
  std::string rest;
  words >> command >> button >> rest;
  if (command.empty()) {
    return {};
  }
  if (rest.empty() && command == "touch") {
    const RomId rom = ParseRomId(button);
    adapter.Touch(rom);
    return "touched " + RomIdText(rom);
  }
  if (command == "leave" && button.empty()) {
    adapter.LeaveAll();
    return "left";
  }
  if (rest.empty() && command == "leave") {
    const RomId rom = ParseRomId(button);
    if (!adapter.Leave(rom)) {
      throw std::invalid_argument("There is no button " + RomIdText(rom) + " at the reader");
    }
    return "left " + RomIdText(rom);
  }
  throw std::invalid_argument("There is no command \"" + line + "\"");
}

}  // namespace sim
