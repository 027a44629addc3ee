#include "takeover/OldSettings.h"

#include <algorithm>
#include <array>
#include <cmath>

#include "core/text/NumberForms.h"
#include "platform/RuntimeError.h"

namespace {

constexpr std::array SettingsOfBoth = {Keys::CommPort, Keys::FirmwarePath, Keys::TotalDamage,
                                       Keys::Respawns, Keys::Heals,        Keys::AmmoAdds,
                                       Keys::Accuracy, Keys::FriendlyFire};

bool IsKey(const Setting& one, const Setting& other) {
  return std::string_view(one.Key) == other.Key && std::string_view(one.Section) == other.Section;
}

/// Nothing if the text is no port number.
std::optional<std::int16_t> PortNumber(const std::string& text) {
  try {
    return ToInt16(text);
  } catch (const RuntimeError&) {
    return std::nullopt;
  }
}

bool IsHere(const Files& disk, const std::string& path) {
  try {
    return path.starts_with('/') && disk.FileExists(path);
  } catch (const RuntimeError&) {
    return false;
  }
}

bool IsFactor(const Setting& setting) {
  return std::string_view(setting.Section) == Keys::TotalDamage.Section;
}

bool IsUsableFactor(const std::string& text) {
  const std::optional<double> value = NumberIn(text);
  return value && std::isfinite(*value);
}

void RequireTexts(const Files& disk, const std::string& path) {
  constexpr std::uint64_t mostBytes = std::uint64_t{1} << 20U;
  if (disk.FileLen(path) > mostBytes || disk.Read(path).find('\0') != std::string::npos) {
    throw RuntimeError(Fault::InvalidFileFormat, "Invalid file format: " + path);
  }
}

}  // namespace

std::size_t OldSettings::Different() const {
  return static_cast<std::size_t>(
      std::count_if(Taken.begin(), Taken.end(), [](const OldSetting& setting) { return setting.Differs; }));
}

OldSettings ReadOldSettings(Files& disk, const std::string& oldPath, const IniReader& inUse,
                            const std::function<bool(std::int16_t)>& hasPort) {
  RequireTexts(disk, oldPath);
  const IniReader old(disk, oldPath);
  OldSettings settings;
  for (const Setting& setting : SettingsOfBoth) {
    // No value has a line break, so this stands for a missing one.
    const std::string value = old.ReadIni(setting.Section, setting.Key, "\n");
    if (value == "\n") {
      continue;
    }
    if (IsKey(setting, Keys::FirmwarePath) && !IsHere(disk, value)) {
      continue;
    }
    if (IsFactor(setting) && !IsUsableFactor(value)) {
      settings.FactorsLeftOut.emplace_back(setting.Key);
      continue;
    }
    if (IsKey(setting, Keys::CommPort)) {
      const std::optional<std::int16_t> port = PortNumber(value);
      if (!port || !hasPort(*port)) {
        settings.PortLeftOut = port;
        continue;
      }
    }
    settings.Taken.push_back({setting.Section, setting.Key, value, value != inUse.ReadIni(setting)});
  }
  return settings;
}

void GiveSettings(Files& disk, const std::string& path, const std::vector<OldSetting>& settings) {
  IniReader ini(disk, path);
  bool written = true;
  ini.AfterWrite = [&written](bool done) { written = written && done; };
  for (const OldSetting& setting : settings) {
    if (setting.Differs) {
      ini.WriteIni(setting.Section, setting.Key, setting.Value);
    }
  }
  if (!written) {
    throw RuntimeError(Fault::PathAccess, "Path/File access error: " + path);
  }
}
