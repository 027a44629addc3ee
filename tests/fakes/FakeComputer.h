#pragma once

#include <optional>
#include <set>
#include <string>
#include <vector>

#include "platform/Computer.h"
#include "platform/RuntimeError.h"

/// A computer on which everything is in order, unless a test says otherwise.
class FakeComputer : public Computer {
 public:
  std::set<std::string> Forbidden;  ///< devices that this user may not open
  std::vector<DeviceUser> Users;    ///< other programs with devices
  std::vector<std::string> AllPrinters = {"Office"};
  std::optional<RuntimeError> PrinterFailure;
  std::optional<bool> Synchronised = true;
  std::string Home = "/home/anna";
  std::string User = "anna";

  bool MayUse(const std::string& device) const override { return !Forbidden.contains(device); }
  std::vector<DeviceUser> UsersOf(const std::vector<std::string>& /*devices*/,
                                  const KeepOn& keepOn) const override {
    return keepOn() ? Users : std::vector<DeviceUser>();
  }
  std::vector<std::string> Printers(const KeepOn& /*keepOn*/) const override {
    if (PrinterFailure) {
      throw *PrinterFailure;
    }
    return AllPrinters;
  }
  std::optional<bool> ClockIsSynchronised() const override { return Synchronised; }
  std::string HomeFolder() const override { return Home; }
  std::string UserName() const override { return User; }
};
