#pragma once

#include <string>
#include <vector>

#include "platform/Computer.h"

class LinuxComputer : public Computer {
 public:
  /// `processes` is the folder in which the system lists them, `locks` that of the files by which programs
  /// lock serial lines for each other. `printerWords` start the program that lists printers, a name on each
  /// line, and then says in a line whether the printing system runs.
  explicit LinuxComputer(std::string processes = "/proc",
                         std::vector<std::string> printerWords = {"env", "LC_ALL=C", "lpstat", "-e", "-r"},
                         std::string locks = "/var/lock");

  bool MayUse(const std::string& device) const override;
  std::vector<DeviceUser> UsersOf(const std::vector<std::string>& devices,
                                  const KeepOn& keepOn) const override;
  /// None where the printing system is not installed. Waits up to eight seconds, since it may ask the network
  /// for five.
  std::vector<std::string> Printers(const KeepOn& keepOn) const override;
  std::optional<bool> ClockIsSynchronised() const override;
  std::string HomeFolder() const override;
  std::string UserName() const override;

 private:
  const std::string processes_;
  const std::vector<std::string> printerWords_;
  const std::string locks_;
};
