#include "platform/linux/LinuxComputer.h"

#include <fcntl.h>
#include <poll.h>
#include <pwd.h>
#include <sys/stat.h>

#include <algorithm>
#include <array>
#include <chrono>
#include <filesystem>
#include <fstream>
#include <optional>
#include <sstream>
#include <utility>

#include "platform/RuntimeError.h"
#include "platform/linux/ChildProcess.h"

namespace {

std::optional<dev_t> DeviceNumber(const std::string& path) {
  struct stat info {};
  return stat(path.c_str(), &info) == 0 && S_ISCHR(info.st_mode) ? std::optional(info.st_rdev) : std::nullopt;
}

/// Devices by their numbers, since one has several names.
using DeviceNumbers = std::vector<std::pair<dev_t, std::string>>;

/// The devices that the process has open.
std::vector<std::string> OpenDevices(const std::filesystem::path& process, const DeviceNumbers& devices) {
  std::vector<std::string> open;
  std::error_code none;
  for (std::filesystem::directory_iterator entry(process / "fd", none), end; entry != end;
       entry.increment(none)) {
    // Only devices are asked for their state: a file of a lost network folder would not answer.
    const std::filesystem::path target = std::filesystem::read_symlink(entry->path(), none);
    const std::optional<dev_t> number =
        target.native().starts_with("/dev/") ? DeviceNumber(entry->path()) : std::nullopt;
    for (const auto& [each, name] : devices) {
      if (number == each && std::find(open.begin(), open.end(), name) == open.end()) {
        open.push_back(name);
      }
    }
  }
  return open;
}

std::string FirstLine(const std::filesystem::path& path) {
  std::string line;
  std::ifstream file(path);
  std::getline(file, line);
  return line;
}

/// What the program writes until its end. Throws RuntimeError 75 when that does not come in time.
std::string OutputOf(const std::vector<std::string>& words, const Computer::KeepOn& keepOn) {
  constexpr std::chrono::seconds patience(3);
  constexpr int betweenQuestions = 20;  // milliseconds
  const Descriptor nothing(open("/dev/null", O_RDWR | O_CLOEXEC));
  Pipe output;
  ChildProcess child(words, {nothing.Number(), output.WriteEnd.Number(), nothing.Number()});
  output.WriteEnd.Close();
  const auto end = std::chrono::steady_clock::now() + patience;
  std::string text;
  while (keepOn()) {
    pollfd watched{output.ReadEnd.Number(), POLLIN, 0};
    std::array<char, 4096> buffer;
    if (poll(&watched, 1, betweenQuestions) > 0) {
      const ssize_t got = read(output.ReadEnd.Number(), buffer.data(), buffer.size());
      if (got <= 0) {
        return text;
      }
      text.append(buffer.data(), static_cast<std::size_t>(got));
    } else if (std::chrono::steady_clock::now() > end) {
      throw RuntimeError(Fault::PathAccess, words.front());
    }
  }
  return {};
}

const passwd* ThisUser() {
  return getpwuid(getuid());
}

}  // namespace

LinuxComputer::LinuxComputer(std::string processes, std::vector<std::string> printerWords)
    : processes_(std::move(processes)), printerWords_(std::move(printerWords)) {}

bool LinuxComputer::MayUse(const std::string& device) const {
  return faccessat(AT_FDCWD, device.c_str(), R_OK | W_OK, AT_EACCESS) == 0;
}

std::vector<DeviceUser> LinuxComputer::UsersOf(const std::vector<std::string>& devices,
                                               const KeepOn& keepOn) const {
  DeviceNumbers numbers;
  for (const std::string& device : devices) {
    if (const std::optional<dev_t> number = DeviceNumber(device)) {
      numbers.emplace_back(*number, device);
    }
  }
  std::vector<DeviceUser> users;
  std::error_code none;
  const std::string ownId = std::to_string(getpid());
  for (std::filesystem::directory_iterator entry(processes_, none), end; entry != end && keepOn();
       entry.increment(none)) {
    const std::string id = entry->path().filename();
    if (id == ownId || id.find_first_not_of("0123456789") != std::string::npos) {
      continue;
    }
    for (const std::string& device : OpenDevices(entry->path(), numbers)) {
      users.push_back({device, FirstLine(entry->path() / "comm")});
    }
  }
  return users;
}

std::vector<std::string> LinuxComputer::Printers(const KeepOn& keepOn) const {
  std::vector<std::string> names;
  std::string output;
  try {
    output = OutputOf(printerWords_, keepOn);
  } catch (const RuntimeError& error) {
    if (error.Number() != Fault::FileNotFound) {
      throw;
    }
  }
  std::istringstream lines(output);
  for (std::string line; std::getline(lines, line);) {
    if (!line.empty()) {
      names.push_back(line);
    }
  }
  return names;
}

std::string LinuxComputer::HomeFolder() const {
  const passwd* user = ThisUser();
  return user != nullptr ? user->pw_dir : std::string();
}

std::string LinuxComputer::UserName() const {
  const passwd* user = ThisUser();
  return user != nullptr ? user->pw_name : std::string();
}
