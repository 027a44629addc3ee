#pragma once

#include <sys/types.h>

#include <filesystem>
#include <fstream>
#include <sstream>
#include <string>
#include <vector>

/// A process on this machine.
struct ProcessInfo {
  pid_t Id;
  pid_t Parent;
  std::string Command;  ///< its arguments, separated by NUL
};

/// Contents of a file below /proc; empty if its process has ended meanwhile.
inline std::string TextOfProcessFile(const std::filesystem::path& path) {
  std::ostringstream text;
  text << std::ifstream(path).rdbuf();
  return text.str();
}

inline std::vector<ProcessInfo> Processes() {
  std::vector<ProcessInfo> processes;
  for (const auto& entry : std::filesystem::directory_iterator("/proc")) {
    const std::string name = entry.path().filename();
    if (name.find_first_not_of("0123456789") != std::string::npos) {
      continue;
    }
    const std::string line = TextOfProcessFile(entry.path() / "stat");
    const auto end = line.rfind(')');
    if (end == std::string::npos || line.substr(end + 2, 1) == "Z") {
      continue;
    }
    processes.push_back(
        {std::stoi(name), std::stoi(line.substr(end + 4)), TextOfProcessFile(entry.path() / "cmdline")});
  }
  return processes;
}

/// Children of `parent` whose command line contains `part`.
inline std::vector<pid_t> ChildrenOf(pid_t parent, const std::string& part) {
  std::vector<pid_t> children;
  for (const ProcessInfo& process : Processes()) {
    if (process.Parent == parent && process.Command.find(part) != std::string::npos) {
      children.push_back(process.Id);
    }
  }
  return children;
}
