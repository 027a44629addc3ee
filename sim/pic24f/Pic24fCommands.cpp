#include "sim/pic24f/Pic24fCommands.h"

#include <fstream>
#include <sstream>
#include <stdexcept>

namespace sim {
namespace {

std::string Save(const Pic24fLoader& loader, const std::string& path) {
  const Pic24fMemory memory = loader.Traffic().Memory;
  std::ofstream file(path, std::ios::binary | std::ios::trunc);
  file << std::string(memory.Program().begin(), memory.Program().end());
  file.close();
  if (!file) {
    throw std::invalid_argument("Cannot write " + path);
  }
  return "saved " + std::to_string(memory.Program().size() / InstructionBytes) + " instructions";
}

}  // namespace

std::string ObeyPic24fCommand(Pic24fLoader& loader, const std::string& line) {
  std::istringstream words(line);
  std::string command;
  std::string rest;
  words >> command >> std::ws;
  std::getline(words, rest);
  if (command.empty()) {
    return {};
  }
  if (command == "reset" && rest.empty()) {
    loader.Reset();
    return "reset";
  }
  if (command == "save" && !rest.empty()) {
    return Save(loader, rest);
  }
  throw std::invalid_argument("There is no command \"" + line + "\"");
}

}  // namespace sim
