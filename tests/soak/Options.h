#pragma once

#include <cstdio>
#include <cstdlib>
#include <functional>
#include <map>
#include <stdexcept>
#include <string>
#include <vector>

/// What each option, "--name", does with its value; may throw std::exception.
using OptionTable = std::map<std::string, std::function<void(const std::string& value)>>;

/// Reads the options of a soak program, "--name value" each. Where they make no sense or do not suffice, it
/// shows the usage and ends the program.
inline void ReadOptions(int argc, char** argv, const OptionTable& options, const char* usage,
                        const std::function<bool()>& suffice) {
  const std::vector<std::string> arguments(argv + 1, argv + argc);
  try {
    for (std::size_t i = 0; i < arguments.size(); i += 2) {
      options.at(arguments[i])(arguments.at(i + 1));
    }
    if (suffice()) {
      return;
    }
  } catch (const std::exception&) {
    std::fputs("Not an option, or not a value for it.\n", stderr);
  }
  std::fputs(usage, stderr);
  std::exit(2);
}
