#pragma once

#include <array>
#include <cstdint>
#include <string>
#include <utility>
#include <vector>

/// The number in `size` bytes, little-endian.
inline std::string LittleEndian(std::uint64_t number, int size) {
  std::string bytes;
  for (int i = 0; i < size; ++i) {
    bytes += static_cast<char>(number >> (8 * i) & 0xFFU);
  }
  return bytes;
}

/// The checksum of zip files.
inline std::uint32_t Crc32(const std::string& bytes) {
  std::uint32_t crc = 0xFFFFFFFF;
  for (const char c : bytes) {
    crc ^= static_cast<std::uint8_t>(c);
    for (int bit = 0; bit < 8; ++bit) {
      crc = (crc >> 1U) ^ (0xEDB88320U & (0U - (crc & 1U)));
    }
  }
  return ~crc;
}

/// A zip file that holds `files` (name and contents), uncompressed.
inline std::string Zip(const std::vector<std::pair<std::string, std::string>>& files) {
  std::string whole;
  std::string directory;
  for (const auto& [name, contents] : files) {
    const auto size = static_cast<std::uint32_t>(contents.size());
    const std::string facts = LittleEndian(20, 2) + std::string(4, '\0') + LittleEndian(0x21, 4) +
                              LittleEndian(Crc32(contents), 4) + LittleEndian(size, 4) +
                              LittleEndian(size, 4) +
                              LittleEndian(static_cast<std::uint32_t>(name.size()), 2);
    directory += "PK\x01\x02" + LittleEndian(20, 2) + facts + std::string(12, '\0') +
                 LittleEndian(static_cast<std::uint32_t>(whole.size()), 4) + name;
    whole += "PK\x03\x04" + facts + std::string(2, '\0') + name + contents;
  }
  const auto count = static_cast<std::uint32_t>(files.size());
  return whole + directory + "PK\x05\x06" + std::string(4, '\0') + LittleEndian(count, 2) +
         LittleEndian(count, 2) + LittleEndian(static_cast<std::uint32_t>(directory.size()), 4) +
         LittleEndian(static_cast<std::uint32_t>(whole.size()), 4) + std::string(2, '\0');
}

/// A Word 2007 file with this body: A4, margins of one inch.
inline std::string Docx(const std::string& body) {
  const std::string head = R"(<?xml version="1.0" encoding="UTF-8" standalone="yes"?>)";
  return Zip(
      {{"[Content_Types].xml",
        head +
            R"(<Types xmlns="http://schemas.openxmlformats.org/package/2006/content-types"><Default Extension="rels" ContentType="application/vnd.openxmlformats-package.relationships+xml"/><Override PartName="/word/document.xml" ContentType="application/vnd.openxmlformats-officedocument.wordprocessingml.document.main+xml"/></Types>)"},
       {"_rels/.rels",
        head +
            R"(<Relationships xmlns="http://schemas.openxmlformats.org/package/2006/relationships"><Relationship Id="rId1" Type="http://schemas.openxmlformats.org/officeDocument/2006/relationships/officeDocument" Target="word/document.xml"/></Relationships>)"},
       {"word/document.xml",
        head +
            R"(<w:document xmlns:w="http://schemas.openxmlformats.org/wordprocessingml/2006/main"><w:body>)" +
            body +
            R"(<w:sectPr><w:pgSz w:w="11906" w:h="16838"/><w:pgMar w:top="1440" w:right="1440" w:bottom="1440" w:left="1440" w:header="708" w:footer="708" w:gutter="0"/></w:sectPr></w:body></w:document>)"}});
}
