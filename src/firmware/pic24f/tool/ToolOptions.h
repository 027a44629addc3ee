#pragma once

#include <cstdint>
#include <string>
#include <vector>

/// What the command line asks for.
struct ToolOptions {
  bool Help = false;
  std::string Command;
  std::string File;        ///< the HEX file of commands that have one
  std::string Out;         ///< --out
  std::string Port;        ///< --port
  std::string DeviceName;  ///< --device; empty: the device tells its identity
  std::int32_t Rate = 115'200;
  bool DespiteWarnings = false;
  bool KeepConfig = false;
};

/// Throws std::invalid_argument with a text for the user.
ToolOptions ParseToolOptions(const std::vector<std::string>& words);

/// The text of --help.
std::string ToolUsage();
