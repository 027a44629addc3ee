#pragma once

#include <string>
#include <vector>

#include "firmware/hex/HexText.h"
#include "tests/fakes/FakeEventPump.h"
#include "tests/fakes/FakeFiles.h"
#include "tests/fakes/FakePicBoot.h"

/// What tests of the boot loader's client need: its ini file, images and the library.
struct BootSite {
  static constexpr const char* Data = "/data";
  static constexpr const char* Program = "/program";

  static constexpr const char* Ini =
      "[PIC24FBOOT]\r\n"
      "progmem=progmem.img\r\needata=eedata.img\r\nuserid=userid.img\r\nconfig=config.img\r\n"
      "errorlog=verify.log\r\neditor=viewer -n\r\nCommTimeOut=1000\r\ndevicemode=0\r\nmaxretry=3\r\n"
      "userresetvector=C00\r\nbootdelay=C02\r\nselectdevwin=0\r\nbitrateindex=8\r\n"
      "[DEVICELIST]\r\n1095=PIC-A\r\n1103=PIC-E\r\n"
      "[PIC-A]\r\npmrangelow=0\r\npmrangehigh=ABFF\r\ncfgrangelow=ABFC\r\ncfgrangehigh=ABFE\r\n"
      "00ABFC=Config Word 2\r\n00ABFE=Config Word 1\r\nbytesperaddr=2\r\nmaxpacketsize=261\r\n"
      "readblock=4\r\nwriteblock=256\r\neraseblock=2048\r\ndevicetype=2\r\n"
      "[PIC-E]\r\npmrangelow=400\r\npmrangehigh=2BFF\r\neerangelow=7FFE00\r\neerangehigh=7FFFFF\r\n"
      "userresetvector=1000\r\nbytesperaddr=2\r\nreadblock=4\r\nwriteblock=256\r\neraseblock=2048\r\n"
      "devicetype=1\r\n";

  BootSite() {
    Disk.AddFolder(Data);
    Disk.Put(std::string(Program) + "/P24qp.ini", Ini);
  }

  /// An image of lines whose bytes are all `byte` except each fourth, which is 0.
  static std::string Image(std::uint32_t address, int lines, unsigned int byte) {
    std::string image;
    for (int line = 0; line < lines; ++line) {
      image += FormatHex(address, 6) + " ";
      for (int i = 0; i < 16; ++i) {
        image += (i % 4 == 3 ? "00" : FormatHex(byte, 2)) + " ";
      }
      image += "\n";
      address += 16;
    }
    return image;
  }

  std::string Log() const { return Disk.Read(std::string(Data) + "/verify.log"); }

  FakeFiles Disk;
  FakeEventPump Events;
  FakePicBoot Library;
};
