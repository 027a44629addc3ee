#pragma once

#include <cstdint>
#include <functional>
#include <optional>
#include <string>
#include <vector>

#include "check/CheckReport.h"
#include "core/data/IniReader.h"
#include "platform/Clock.h"
#include "platform/Computer.h"
#include "platform/Database.h"
#include "platform/Files.h"
#include "platform/SerialDevices.h"

/// What is known of the word processor.
enum class WordFinding {
  Missing,
  Untried,  ///< its start has not ended
  Ready,
  Ended  ///< since it was ready
};

/// Looks at what the program needs of the computer, subject by subject. Changes nothing, and opens no port.
class SystemChecks {
 public:
  struct Parts {
    const StringTable& Strings;
    const Clock& Time;
    const ::Computer& Computer;
    const SerialDevices& Devices;
    const IniReader& Ini;
    Files& Disk;
    DatabaseEngine& Databases;
    std::string UserDataFolder;
    std::function<WordFinding()> WordProcessor;
    std::function<std::string()>
        ChineseLetters;  ///< name of letters with which Chinese is written; empty if none
    std::function<std::vector<std::string>()> Screens;        ///< a text about each
    std::function<std::optional<std::int16_t>()> ReaderPort;  ///< number; nothing if none is set
    /// Path of the database that is open for this subject, missions or members.
    std::function<std::string(CheckSubject)> PathInUse;
    std::string Release = {};  ///< with the package's version where there is one: "... (3.54+20261120.1203)"
  };

  /// Less free space is told as too little.
  static constexpr std::uint64_t LeastFreeMegabytes = 500;

  /// The parts must outlive this object.
  explicit SystemChecks(Parts parts) : parts_(std::move(parts)) {}

  /// What there is to tell about the subject: at least one item, unless `keepOn` said that it should stop.
  /// `keepOn` is asked every few milliseconds where that takes long. Never throws: what fails is told.
  std::vector<CheckItem> Look(CheckSubject subject, const KeepOn& keepOn) const;

 private:
  using Items = std::vector<CheckItem>;

  std::string Text(OwnText text, std::initializer_list<std::string_view> values = {}) const;
  Items LookAt(CheckSubject subject, const KeepOn& keepOn) const;
  Items Ports(const KeepOn& keepOn) const;
  CheckItem Device(CheckSubject subject, const std::string& device, const std::string& fineText,
                   const std::vector<DeviceUser>& users) const;
  CheckItem Port(CheckSubject subject, std::int16_t number, const KeepOn& keepOn) const;
  CheckItem Reader(const KeepOn& keepOn) const;
  CheckItem Word() const;
  CheckItem Printer(const KeepOn& keepOn) const;
  CheckItem Screens() const;
  Items Disk() const;
  CheckItem Clock() const;
  /// True if the program's data was changed after `now`.
  bool HasDataAfter(const std::string& now) const;
  Items DatabaseOf(CheckSubject subject, const KeepOn& keepOn) const;
  CheckItem DatabaseAt(CheckSubject subject, const std::string& path, const char* table,
                       const KeepOn& keepOn) const;
  /// The file of the usual name, if another one is in use since it cannot be.
  Items PutAside(CheckSubject subject, const std::string& path, const std::string& inUse,
                 const KeepOn& keepOn) const;
  std::string LastCopyOf(const std::string& database) const;

  const Parts parts_;
};
