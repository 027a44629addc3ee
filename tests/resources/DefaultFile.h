#pragma once

#include <filesystem>
#include <fstream>
#include <iterator>
#include <string>

/// Path of a data file beside the built program.
inline std::filesystem::path DefaultFile(const std::string& name) {
  return std::filesystem::path(TESSARINE_PROGRAM_FOLDER) / name;
}

/// All bytes of a data file beside the built program; empty if it is missing.
inline std::string DefaultFileBytes(const std::string& name) {
  std::ifstream file(DefaultFile(name), std::ios::binary);
  return {std::istreambuf_iterator<char>(file), std::istreambuf_iterator<char>()};
}
