#include "firmware/pic24f/BootSettings.h"

BootSettings ReadBootSettings(const BootIni& ini) {
  const std::string section = BootIni::GeneralSection;
  return {.ProgMem = ini.ReadBootIni(section, "progmem"),
          .EeData = ini.ReadBootIni(section, "eedata"),
          .UserId = ini.ReadBootIni(section, "userid"),
          .Config = ini.ReadBootIni(section, "config"),
          .ErrorLog = ini.ReadBootIni(section, "errorlog"),
          .Editor = ini.ReadBootIni(section, "editor"),
          .CommTimeOut = ini.Decimal(section, "CommTimeOut"),
          .DebugLevel = ini.Decimal(section, "debuglevel"),
          .DeviceMode = ini.Decimal(section, "devicemode"),
          .MaxRetry = ini.Decimal16(section, "maxretry"),
          .UserResetVector = ini.Hexadecimal(section, "userresetvector"),
          .BootDelay = ini.Hexadecimal(section, "bootdelay"),
          .SelectDevWin = ini.Decimal(section, "selectdevwin"),
          .BitRateIndex = ini.Decimal(section, "bitrateindex")};
}

PicDevice ReadPicDevice(const BootIni& ini, const std::string& section, const BootSettings& settings) {
  const auto addressOr = [&](const char* key, std::uint32_t general) {
    return ini.ReadBootIni(section, key).empty() ? general : ini.Hexadecimal(section, key);
  };
  return {.PmRangeLow = ini.Hexadecimal(section, "pmrangelow"),
          .PmRangeHigh = ini.Hexadecimal(section, "pmrangehigh"),
          .EeRangeLow = ini.Hexadecimal(section, "eerangelow"),
          .EeRangeHigh = ini.Hexadecimal(section, "eerangehigh"),
          .UsrRangeLow = ini.Hexadecimal(section, "usrrangelow"),
          .UsrRangeHigh = ini.Hexadecimal(section, "usrrangehigh"),
          .CfgRangeLow = ini.Hexadecimal(section, "cfgrangelow"),
          .CfgRangeHigh = ini.Hexadecimal(section, "cfgrangehigh"),
          .UserResetVector = addressOr("userresetvector", settings.UserResetVector),
          .BootDelay = addressOr("bootdelay", settings.BootDelay),
          .BytesPerAddr = ini.DecimalByte(section, "bytesperaddr"),
          .MaxPacketSize = ini.Decimal(section, "maxpacketsize"),
          .EraseBlock = ini.Decimal16(section, "eraseblock"),
          .ReadBlock = ini.Decimal16(section, "readblock"),
          .WriteBlock = ini.Decimal16(section, "writeblock"),
          .DeviceType = ini.Decimal16(section, "devicetype")};
}
