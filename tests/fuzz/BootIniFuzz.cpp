#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <string>

#include "firmware/pic24f/PicComms.h"
#include "platform/RuntimeError.h"
#include "tests/fakes/FakeEventPump.h"
#include "tests/fakes/FakeFiles.h"
#include "tests/fakes/FakePicBoot.h"

namespace {

void Require(bool condition) {
  if (!condition) {
    std::abort();
  }
}

}  // namespace

/// The input is the ini file: its settings, the device 1095, and an erase by what it tells of the device.
extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  FakeFiles files;
  files.Put("/program/P24qp.ini", std::string(data, data + size));
  const BootIni ini(files, {"/data", "/program"});
  FakePicBoot library;
  FakeEventPump events;
  PicComms comms({.Library = library,
                  .Disk = files,
                  .Events = events,
                  .Folder = {"/data", "/program"},
                  .ShowStatus = [](const std::string&) {}});
  try {
    comms.Settings = ReadBootSettings(ini);
    const std::string section = ini.ReadBootIni(BootIni::DeviceListSection, "1095");
    Require(section.size() <= 19);
    comms.Device = ReadPicDevice(ini, section, comms.Settings);
    comms.EraseRangeDevice(static_cast<std::int32_t>(comms.Device.PmRangeLow),
                           static_cast<std::int32_t>(comms.Device.PmRangeHigh));
  } catch (const RuntimeError& error) {
    Require(error.Number() == 5 || error.Number() == 6 || error.Number() == 11 || error.Number() == 13);
  }
  Require(library.Log.size() <= 1000);  // it never erases for ever
  return 0;
}
