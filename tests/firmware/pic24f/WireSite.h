#pragma once

#include <algorithm>
#include <cstdint>
#include <string>
#include <utility>
#include <vector>

#include "platform/linux/LinuxFiles.h"
#include "platform/qt/QtEventPump.h"
#include "platform/qt/QtSerialPort.h"
#include "sim/pic24f/Pic24fLoader.h"
#include "tests/firmware/hex/HexFile.h"
#include "tests/resources/DefaultFile.h"
#include "tests/support/TemporaryFolder.h"

/// What tests with a simulated boot loader need: real files, a real line, and what the device must hold.
struct WireSite {
  using Bytes = std::vector<std::uint8_t>;

  /// The shipped ini file with an answer's time that tests can wait for, and two devices of theirs.
  WireSite() {
    std::string ini = DefaultFileBytes("P24qp.ini");
    const std::string told = "CommTimeOut=1000";
    ini.replace(ini.find(told), told.size(), "CommTimeOut=600");
    ini +=
        "\n[ONE PAGE]\npmrangelow=0\npmrangehigh=3FF\nbytesperaddr=2\nreadblock=4\nwriteblock=256\n"
        "eraseblock=2048\ndevicetype=2\n"
        "\n[WITH EEPROM]\npmrangelow=0\npmrangehigh=2BFF\neerangelow=7FFE00\neerangehigh=7FFFFF\n"
        "bytesperaddr=2\nreadblock=4\nwriteblock=256\neraseblock=2048\ndevicetype=1\n";
    WriteFile(Folder / "P24qp.ini", ini);
  }

  /// A program's bytes at a file address: all values, the marks of the line among them.
  static Bytes ProgramBytes(std::uint32_t address, std::size_t count) {
    Bytes bytes(count);
    for (std::size_t i = 0; i < count; ++i) {
      const std::size_t at = address + i;
      bytes[i] = at % 4 == 3 ? 0 : static_cast<std::uint8_t>(at * 0x55 + at / 256 * 3);
    }
    return bytes;
  }

  /// Records of these bytes, behind a record of their upper address.
  static std::string Records(std::uint32_t address, const Bytes& bytes) {
    std::string text = HexFile::Upper(address / 65536);
    for (std::size_t i = 0; i < bytes.size(); i += 16) {
      const auto from = bytes.begin() + static_cast<std::ptrdiff_t>(i);
      text += HexFile::Data((address + i) % 65536, Bytes(from, from + 16));
    }
    return text;
  }

  static Bytes Erased(std::size_t count) {
    Bytes bytes(count, 0xFF);
    for (std::size_t i = 3; i < count; i += 4) {
      bytes[i] = 0;
    }
    return bytes;
  }

  /// Program memory that is erased but for these stretches, by file address. Its first two instructions lead
  /// to the loader.
  static Bytes Holding(std::uint32_t instructions,
                       const std::vector<std::pair<std::uint32_t, Bytes>>& stretches) {
    Bytes memory = Erased(std::size_t{instructions} * 4);
    for (const auto& [address, bytes] : stretches) {
      std::copy(bytes.begin(), bytes.end(), memory.begin() + static_cast<std::ptrdiff_t>(address));
    }
    const Bytes jump = {0x00, 0x04, 0x04, 0x00, 0x00, 0x00, 0x00, 0x00};
    std::copy(jump.begin(), jump.end(), memory.begin());
    return memory;
  }

  /// The device that the shipped ini file lists first.
  static sim::Pic24fLoaderSettings Listed(sim::Pic24fFailure failure, std::size_t place) {
    return {.Device = {.Identity = 1095, .Instructions = 22'016},
            .Failure = failure,
            .FailurePlace = place,
            .LinePace = sim::Pace::Fast,
            .Lateness = std::chrono::milliseconds(900)};
  }

  TemporaryFolder Folder;
  LinuxFiles Disk;
  QtEventPump Events;
  QtSerialPort Port;
};
