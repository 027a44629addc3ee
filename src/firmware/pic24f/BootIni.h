#pragma once

#include <cstdint>
#include <string>

#include "firmware/pic24f/BootFolder.h"

/// The settings of the boot loader's window, and what it knows of devices. The file is read with each value,
/// so that a change counts at once.
class BootIni {
 public:
  static constexpr const char* FileName = "P24qp.ini";
  static constexpr const char* GeneralSection = "PIC24FBOOT";
  static constexpr const char* DeviceListSection = "DEVICELIST";

  /// `files` must outlive this object.
  BootIni(Files& files, BootFolder folder) : files_(files), folder_(std::move(folder)) {}

  /// The value up to its first NUL, at most 19 bytes; empty if there is none.
  std::string ReadBootIni(const std::string& section, const std::string& key) const;

  /// Values as numbers; 0 if there is none. Throw RuntimeError 13 for a text that is no such number, 6 if it
  /// is out of range.
  std::int32_t Decimal(const std::string& section, const std::string& key) const;
  std::int16_t Decimal16(const std::string& section, const std::string& key) const;
  std::uint8_t DecimalByte(const std::string& section, const std::string& key) const;
  std::uint32_t Hexadecimal(const std::string& section, const std::string& key) const;

 private:
  Files& files_;
  BootFolder folder_;
};
