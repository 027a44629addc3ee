#include "firmware/pic24f/BootIni.h"

#include "core/data/IniReader.h"
#include "core/text/NumberForms.h"
#include "core/text/TextEncoding.h"
#include "firmware/hex/HexText.h"

std::string BootIni::ReadBootIni(const std::string& section, const std::string& key) const {
  constexpr std::size_t mostBytes = 19;
  const IniReader ini(files_, folder_.ForReading(files_, FileName));
  const std::string value = ini.ReadIni(section, key, "");
  return std::string(FirstBytes(std::string_view(value).substr(0, value.find('\0')), mostBytes));
}

std::int32_t BootIni::Decimal(const std::string& section, const std::string& key) const {
  const std::string value = ReadBootIni(section, key);
  return value.empty() ? 0 : ToInt32(value);
}

std::int16_t BootIni::Decimal16(const std::string& section, const std::string& key) const {
  const std::string value = ReadBootIni(section, key);
  return value.empty() ? std::int16_t{0} : ToInt16(value);
}

std::uint8_t BootIni::DecimalByte(const std::string& section, const std::string& key) const {
  const std::string value = ReadBootIni(section, key);
  return value.empty() ? std::uint8_t{0} : ToByte(value);
}

std::uint32_t BootIni::Hexadecimal(const std::string& section, const std::string& key) const {
  const std::string value = ReadBootIni(section, key);
  return value.empty() ? 0 : HexNumber(value);
}
