#include "platform/linux/PortLocks.h"

#include <sys/stat.h>
#include <unistd.h>

#include <cstdint>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <sstream>

namespace {

constexpr std::size_t LongestLock = 1024;  // a number, and perhaps the names of program and computer

/// The first bytes of a file; none unless it is a plain file that this user may read.
std::string LockBytes(const std::string& path) {
  struct stat info {};
  if (stat(path.c_str(), &info) != 0 || !S_ISREG(info.st_mode)) {
    return {};
  }
  std::string bytes(LongestLock, '\0');
  std::ifstream file(path, std::ios::binary);
  file.read(bytes.data(), static_cast<std::streamsize>(bytes.size()));
  bytes.resize(static_cast<std::size_t>(file.gcount()));
  return bytes;
}

/// The process number in a lock: in decimal digits behind blanks, or as the four bytes of a number. 0 if
/// there is none.
std::int32_t ProcessIn(const std::string& lock) {
  constexpr std::size_t binarySize = 4;
  std::int32_t number = 0;
  std::istringstream text(lock);
  if (!(text >> number) && lock.size() == binarySize) {
    lock.copy(reinterpret_cast<char*>(&number), binarySize);
  }
  return number > 0 ? number : 0;
}

/// The value in the first line of `path` that begins with `name`.
std::int64_t NumberBehind(const std::string& name, const std::string& path) {
  std::ifstream file(path);
  std::string word;
  std::int64_t number = 0;
  while (file >> word) {
    if (word == name) {
      file >> number;
      break;
    }
  }
  return number;
}

/// When the process began, in seconds since 1970; 0 if that cannot be told.
std::int64_t BeginOf(const std::string& process, const std::string& processes) {
  constexpr int fieldsBetween = 19;  // behind the name, which may hold blanks and brackets
  std::ifstream file(process + "/stat");
  const std::string all((std::istreambuf_iterator<char>(file)), std::istreambuf_iterator<char>());
  const std::size_t nameEnd = all.rfind(')');
  const std::int64_t boot = NumberBehind("btime", processes + "/stat");
  if (nameEnd == std::string::npos || boot == 0) {
    return 0;
  }
  std::istringstream fields(all.substr(nameEnd + 1));
  std::string field;
  for (int count = 0; count < fieldsBetween; ++count) {
    fields >> field;
  }
  std::int64_t ticks = 0;
  fields >> ticks;
  return boot + ticks / sysconf(_SC_CLK_TCK);
}

}  // namespace

std::optional<std::string> LockHolder(const std::string& device, const std::string& locks,
                                      const std::string& processes) {
  constexpr std::int64_t grace = 5;  // seconds, by which the clock may have been set since the system's start
  std::error_code none;
  const std::filesystem::path real = std::filesystem::canonical(device, none);
  const std::string path = locks + "/LCK.." + real.filename().string();
  const std::int32_t id = none ? 0 : ProcessIn(LockBytes(path));
  const std::string process = processes + "/" + std::to_string(id);
  struct stat lock {};
  if (id == 0 || id == getpid() || !std::filesystem::exists(process, none) ||
      stat(path.c_str(), &lock) != 0 ||
      BeginOf(process, processes) > lock.st_mtime + grace) {  // the number is another program's by now
    return std::nullopt;
  }
  std::ifstream file(process + "/comm");
  std::string name;
  std::getline(file, name);
  return name.empty() ? std::to_string(id) : name;
}
