#include "sim/onewire/ButtonCommands.h"

#include <sstream>
#include <stdexcept>
#include <string_view>
#include <vector>

namespace sim {
namespace {

std::string Leave(OneWireAdapter& adapter, const std::string& button) {
  const RomId rom = ParseRomId(button);
  if (!adapter.Leave(rom)) {
    throw std::invalid_argument("There is no button " + RomIdText(rom) + " at the reader");
  }
  return "left " + RomIdText(rom);
}

std::string Fill(OneWireAdapter& adapter, const std::string& button, const std::string& content) {
  const RomId rom = ParseRomId(button);
  adapter.Fill(rom, ParseButtonContent(content));
  return "filled " + RomIdText(rom);
}

std::string Show(OneWireAdapter& adapter, const std::string& button) {
  constexpr std::string_view digits = "0123456789ABCDEF";
  const RomId rom = ParseRomId(button);
  std::string text = RomIdText(rom);
  for (const std::uint8_t byte : adapter.BlockOf(rom)) {
    text += ' ';
    text += digits[byte >> 4U];
    text += digits[byte & 15U];
  }
  return text;
}

}  // namespace

std::string ObeyButtonCommand(OneWireAdapter& adapter, const std::string& line) {
  std::istringstream input(line);
  std::vector<std::string> words;
  for (std::string word; input >> word;) {
    words.push_back(word);
  }
  if (words.empty()) {
    return {};
  }
  if (words.size() == 1 && words[0] != "leave") {
    words.emplace_back();
  }
  if (words.size() == 2 && words[0] == "touch") {
    const RomId rom = ParseRomId(words[1]);
    adapter.Touch(rom);
    return "touched " + RomIdText(rom);
  }
  if (words.size() == 1 && words[0] == "leave") {
    adapter.LeaveAll();
    return "left";
  }
  if (words.size() == 2 && words[0] == "leave") {
    return Leave(adapter, words[1]);
  }
  if (words.size() == 3 && words[0] == "fill") {
    return Fill(adapter, words[1], words[2]);
  }
  if (words.size() == 2 && words[0] == "show") {
    return Show(adapter, words[1]);
  }
  throw std::invalid_argument("There is no command \"" + line + "\"");
}

}  // namespace sim
