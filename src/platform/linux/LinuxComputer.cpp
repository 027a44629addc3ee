#include "platform/linux/LinuxComputer.h"

#include <fcntl.h>
#include <pwd.h>
#include <sys/stat.h>
#include <sys/timex.h>
#include <unistd.h>

#include <algorithm>
#include <chrono>
#include <filesystem>
#include <fstream>
#include <optional>
#include <sstream>
#include <utility>

#include "platform/RuntimeError.h"
#include "platform/linux/PortLocks.h"
#include "platform/linux/ProgramOutput.h"

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

constexpr const char* SchedulerIs = "scheduler is ";

/// The lines of a text that are not empty.
std::vector<std::string> LinesOf(const std::string& text) {
  std::vector<std::string> found;
  std::istringstream lines(text);
  for (std::string line; std::getline(lines, line);) {
    if (!line.empty()) {
      found.push_back(line);
    }
  }
  return found;
}

/// True if the program that starts others says that there is none of that name.
bool IsMissing(const std::string& errors) {
  return errors.starts_with("env: ");
}

const passwd* ThisUser() {
  return getpwuid(getuid());
}

}  // namespace

LinuxComputer::LinuxComputer(std::string processes, std::vector<std::string> printerWords, std::string locks)
    : processes_(std::move(processes)), printerWords_(std::move(printerWords)), locks_(std::move(locks)) {}

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
  for (const std::string& device : devices) {
    const std::optional<std::string> holder = LockHolder(device, locks_, processes_);
    if (holder && std::find(users.begin(), users.end(), DeviceUser{device, *holder}) == users.end()) {
      users.push_back({device, *holder});
    }
  }
  return users;
}

std::vector<std::string> LinuxComputer::Printers(const KeepOn& keepOn) const {
  constexpr std::chrono::seconds patience(8);
  ProgramOutput output;
  try {
    output = RunToEnd(printerWords_, patience, keepOn);
  } catch (const RuntimeError& error) {
    if (error.Number() == Fault::FileNotFound) {
      return {};
    }
    throw RuntimeError(error.Number(), "lpstat, " + std::to_string(patience.count()) + " s");
  }
  std::vector<std::string> lines = LinesOf(output.Text);
  const std::string state = !lines.empty() && lines.back().starts_with(SchedulerIs) ? lines.back() : "";
  if (!state.empty()) {
    lines.pop_back();
  }
  // Printers in the network are listed without it.
  if (lines.empty() && state.find(" not ") != std::string::npos) {
    throw RuntimeError(Fault::DeviceUnavailable, state);
  }
  if (lines.empty() && !output.Errors.empty() && !IsMissing(output.Errors)) {
    throw RuntimeError(Fault::DeviceUnavailable, LinesOf(output.Errors).front());
  }
  return lines;
}

std::optional<bool> LinuxComputer::ClockIsSynchronised() const {
  timex state{};
  const int result = adjtimex(&state);
  return result < 0 ? std::nullopt : std::optional(result != TIME_ERROR && (state.status & STA_UNSYNC) == 0);
}

std::string LinuxComputer::HomeFolder() const {
  const passwd* user = ThisUser();
  return user != nullptr ? user->pw_dir : std::string();
}

std::string LinuxComputer::UserName() const {
  const passwd* user = ThisUser();
  return user != nullptr ? user->pw_name : std::string();
}
