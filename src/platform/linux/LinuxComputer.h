#pragma once

#include <string>
#include <vector>

#include "platform/Computer.h"

class LinuxComputer : public Computer {
 public:
  /// `processes` is the folder in which the system lists them; `printerWords` start the program that lists
  /// printers, a name on each line.
  explicit LinuxComputer(std::string processes = "/proc",
                         std::vector<std::string> printerWords = {"lpstat", "-e"});

  bool MayUse(const std::string& device) const override;
  std::vector<DeviceUser> UsersOf(const std::vector<std::string>& devices,
                                  const KeepOn& keepOn) const override;
  /// None where the printing system is not installed. Throws RuntimeError 75 if it says nothing for three
  /// seconds.
  std::vector<std::string> Printers(const KeepOn& keepOn) const override;
  std::string HomeFolder() const override;
  std::string UserName() const override;

 private:
  const std::string processes_;
  const std::vector<std::string> printerWords_;
};
