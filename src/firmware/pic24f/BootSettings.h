#pragma once

#include <cstdint>
#include <string>

#include "firmware/hex/HexImport.h"
#include "firmware/pic24f/BootIni.h"

/// Section PIC24FBOOT of the ini file.
struct BootSettings {
  std::string ProgMem;  ///< names of the images
  std::string EeData;
  std::string UserId;  ///< read, but nothing is written to it
  std::string Config;
  std::string ErrorLog;          ///< log of the differences between device and image
  std::string Editor;            ///< program that shows it, with its arguments
  std::int32_t CommTimeOut = 0;  ///< ms
  std::int32_t DebugLevel = 0;
  std::int32_t DeviceMode = 0;  ///< 0: ask the device for its identity
  std::int16_t MaxRetry = 0;
  std::uint32_t UserResetVector = 0;  ///< device addresses that the boot loader itself changes
  std::uint32_t BootDelay = 0;
  std::int32_t SelectDevWin = 0;  ///< other than 0: open the device selector first
  std::int32_t BitRateIndex = 0;  ///< 1 to 8

  /// Where the images are written.
  ImagePaths Images(const BootFolder& folder) const {
    return {folder.ForWriting(ProgMem), folder.ForWriting(EeData), folder.ForWriting(Config)};
  }
};

/// What the ini file tells of a device. Ranges are device addresses; the initial ones hold until a device is
/// known.
struct PicDevice {
  std::uint32_t PmRangeLow = 512;
  std::uint32_t PmRangeHigh = 512;
  std::uint32_t EeRangeLow = 0;
  std::uint32_t EeRangeHigh = 0;
  std::uint32_t UsrRangeLow = 0x200000;
  std::uint32_t UsrRangeHigh = 0x200000;
  std::uint32_t CfgRangeLow = 0x300000;
  std::uint32_t CfgRangeHigh = 0x300000;
  std::uint32_t UserResetVector = 0;
  std::uint32_t BootDelay = 0;
  std::uint8_t BytesPerAddr = 0;
  std::int32_t MaxPacketSize = 0;
  std::int16_t EraseBlock = 0;  ///< bytes, as the next two
  std::int16_t ReadBlock = 0;
  std::int16_t WriteBlock = 0;
  std::int16_t DeviceType = 0;  ///< 1: has EEPROM; 2: configuration words at the end of program memory
};

/// Throw RuntimeError 13 or 6 for a value that is no number of its kind.
BootSettings ReadBootSettings(const BootIni& ini);
PicDevice ReadPicDevice(const BootIni& ini, const std::string& section, const BootSettings& settings);
