#include "sim/bootcode/BootCommands.h"

#include <algorithm>
#include <charconv>
#include <sstream>
#include <stdexcept>
#include <vector>

namespace sim {
namespace {

BootFailure ParseFailure(const std::string& name) {
  const auto* found = std::find_if(BootFailures.begin(), BootFailures.end(),
                                   [&](const BootFailureInfo& info) { return info.Name == name; });
  if (found == BootFailures.end()) {
    throw std::invalid_argument("The boot code has no failure \"" + name + "\"");
  }
  return found->Failure;
}

std::size_t ParsePlace(const std::string& text) {
  std::size_t place = 0;
  const std::from_chars_result result = std::from_chars(text.data(), text.data() + text.size(), place);
  if (result.ec != std::errc() || result.ptr != text.data() + text.size()) {
    throw std::invalid_argument("A place is a number from 1 on, unlike \"" + text + "\"");
  }
  return place;
}

}  // namespace

std::string ObeyBootCommand(BootCode& device, const std::string& line) {
  std::istringstream input(line);
  std::vector<std::string> words;
  for (std::string word; input >> word;) {
    words.push_back(word);
  }
  if (words.empty()) {
    return {};
  }
  if (words[0] != "power" || words.size() > 3) {
    throw std::invalid_argument("There is no command \"" + line + "\"");
  }
  std::optional<BootTrouble> trouble;
  if (words.size() > 1) {
    trouble = BootTrouble{.Failure = ParseFailure(words[1])};
  }
  if (words.size() > 2) {
    trouble->Place = ParsePlace(words[2]);
  }
  device.PowerOn(trouble);
  return "switched on";
}

}  // namespace sim
