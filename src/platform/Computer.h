#pragma once

#include <functional>
#include <optional>
#include <string>
#include <vector>

/// A program that has a device open.
struct DeviceUser {
  std::string Device;   ///< as it was asked for
  std::string Program;  ///< name

  bool operator==(const DeviceUser&) const = default;
};

/// What can be found out about this computer and its user. `keepOn` is asked every few milliseconds in the
/// middle of what takes long; it may process events. False ends the search, whose result is then worth
/// nothing.
class Computer {
 public:
  using KeepOn = std::function<bool()>;

  virtual ~Computer() = default;

  /// True if this user may read and write the device.
  virtual bool MayUse(const std::string& device) const = 0;

  /// The other programs that have one of these devices open. Those of other users are seen only where they
  /// have locked the device by a file.
  virtual std::vector<DeviceUser> UsersOf(const std::vector<std::string>& devices,
                                          const KeepOn& keepOn) const = 0;

  /// Names of the printers that are set up. Throws RuntimeError 68 if the printing system does not run, or
  /// tells nothing in time; the text is the system's own.
  virtual std::vector<std::string> Printers(const KeepOn& keepOn) const = 0;

  /// True if a time server keeps the clock right; nothing if the system does not tell.
  virtual std::optional<bool> ClockIsSynchronised() const = 0;

  /// The user's own folder, and the user's name; empty if unknown.
  virtual std::string HomeFolder() const = 0;
  virtual std::string UserName() const = 0;
};
