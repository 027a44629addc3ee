#pragma once

#include <cstdint>
#include <functional>
#include <optional>
#include <string>
#include <vector>

#include "core/data/IniReader.h"
#include "platform/Files.h"

/// One setting that an old installation may have.
struct OldSetting {
  std::string Section;
  std::string Key;
  std::string Value;
  bool Differs = false;  ///< from what is in use

  bool operator==(const OldSetting&) const = default;
};

/// What an old ini file gives to the one in use. Only the settings that both kinds of installation have:
/// devices, and what only this program knows, belong to this computer.
struct OldSettings {
  std::vector<OldSetting> Taken;
  std::optional<std::int16_t> PortLeftOut;  ///< number of a serial port that this computer does not have
  std::vector<std::string> FactorsLeftOut;  ///< keys of soldiering factors that are no numbers

  std::size_t Different() const;
};

/// Reads the old ini file. The number of the serial port counts only if `hasPort` says so, the firmware file
/// only if it is on this computer, a soldiering factor only if it is a number that this program can use: with
/// any other it would not start. Throws RuntimeError 321 for a file that is none of texts, and
/// as Files::Read does.
OldSettings ReadOldSettings(Files& disk, const std::string& oldPath, const IniReader& inUse,
                            const std::function<bool(std::int16_t)>& hasPort);

/// Gives them to the ini file at `path`; every other line stays as it is. Throws RuntimeError 75 if that
/// fails.
void GiveSettings(Files& disk, const std::string& path, const std::vector<OldSetting>& settings);
