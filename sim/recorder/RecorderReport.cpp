#include "sim/recorder/RecorderReport.h"

#include <iomanip>
#include <sstream>
#include <stdexcept>

namespace sim {

std::string RecorderReport(const SoundChip& chip) {
  std::ostringstream text;
  for (const auto& [number, samples] : chip.Sounds()) {
    if (text.tellp() > 0) {
      text << '\n';
    }
    text << "sound " << static_cast<int>(number) << ": " << samples.size() / PageBytes << " pages, "
         << std::fixed << std::setprecision(2) << static_cast<double>(samples.size()) / SamplesPerSecond
         << " s";
  }
  return text.tellp() > 0 ? text.str() : "no sounds";
}

std::string ObeyRecorderCommand(const SoundRecorder& recorder, const std::string& line) {
  std::istringstream words(line);
  std::string command;
  std::string rest;
  words >> command >> rest;
  if (command.empty()) {
    return {};
  }
  if (command == "sounds" && rest.empty()) {
    return RecorderReport(recorder.Traffic().Chip);
  }
  throw std::invalid_argument("There is no command \"" + line + "\"");
}

}  // namespace sim
