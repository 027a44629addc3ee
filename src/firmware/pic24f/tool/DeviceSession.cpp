#include "firmware/pic24f/tool/DeviceSession.h"

#include <algorithm>

#include "firmware/hex/HexCheck.h"
#include "firmware/hex/HexText.h"
#include "firmware/pic24f/PicFrame.h"
#include "firmware/pic24f/tool/HexCommands.h"

namespace {

constexpr std::int32_t DefaultTimeOut = 1000;  // ms
constexpr std::int16_t DefaultRetries = 3;
constexpr std::int16_t HasEeprom = 1;  // device types
constexpr std::int16_t HasConfigAtEnd = 2;
constexpr std::uint32_t LastPage = 1024;  // device addresses
constexpr std::size_t MostDifferences = 20;

}  // namespace

DeviceSession::DeviceSession(const Parts& parts, const ToolOptions& options)
    : parts_(parts),
      options_(options),
      images_(parts.Tool.Disk),
      ini_(parts.Tool.Disk, parts.Folder),
      library_({.Port = parts.Line,
                .Events = parts.Events,
                .DeviceOf = parts.DeviceOf,
                .Stopped = [this] { return parts_.StopRequests() > (state_ == State::Untouched ? 0 : 1); }}),
      comms_({.Library = library_,
              .Disk = parts.Tool.Disk,
              .Events = parts.Events,
              .Folder = {images_.Folder(), images_.Folder()},
              .ShowStatus = [this](const std::string&) { ObeyStop(); },
              .ShowProgress = parts.ShowProgress}) {}

void DeviceSession::ReadSettings() {
  comms_.Settings = ReadBootSettings(ini_);
  comms_.Settings.ProgMem = images_.ProgMem();
  comms_.Settings.EeData = images_.EeData();
  comms_.Settings.ErrorLog = images_.Log();
  if (comms_.Settings.CommTimeOut <= 0) {
    comms_.Settings.CommTimeOut = DefaultTimeOut;
  }
  if (comms_.Settings.MaxRetry <= 0) {
    comms_.Settings.MaxRetry = DefaultRetries;
  }
}

std::int32_t DeviceSession::Run() {
  ReadSettings();
  if (!options_.File.empty() && !ImportFile()) {
    return Refused;
  }
  comms_.PortHandle = library_.OpenPIC(options_.Port, options_.Rate, comms_.Settings.CommTimeOut);
  if (comms_.PortHandle < 0) {
    Complain(options_.Port + " cannot be opened at " + std::to_string(options_.Rate) + " bit/s");
    return comms_.PortHandle;
  }
  const std::int32_t code = Converse();
  library_.ClosePIC(comms_.PortHandle);
  return code == SerialPicBoot::Ended && StopAsked() ? std::int32_t{PicCode::Aborted} : code;
}

bool DeviceSession::ImportFile() {
  const ImportedHex imported = ImportHex(parts_.Tool, options_.File, images_.Paths());
  if (imported.Code != HexCode::Good) {
    return false;
  }
  warnings_ = imported.Warnings;
  hasEeData_ = parts_.Tool.Disk.FileLen(images_.Paths().EeData) > 0;
  if (options_.Command == "write" && !warnings_.empty() && !options_.DespiteWarnings) {
    Complain(options_.File + " is not written: the device would not get all of it (--despite-warnings)");
    return false;
  }
  return true;
}

std::int32_t DeviceSession::Converse() {
  if (options_.Command == "run") {
    comms_.ResetDevice();
    return PicCode::Done;
  }
  if (options_.Command == "identify") {
    return Identify();
  }
  if (!FindDevice()) {
    return StopAsked() ? std::int32_t{PicCode::Aborted} : Refused;
  }
  return options_.Command == "erase" ? Erase() : options_.Command == "write" ? Write() : Verify();
}

std::int32_t DeviceSession::Identify() {
  const std::string version = comms_.ReadBootVersion();
  const std::string identity = comms_.ReadDeviceId();
  if (identity == "0" && StopAsked()) {
    return PicCode::Aborted;
  }
  if (identity == "0") {
    Complain("the device does not tell its identity");
    return Refused;
  }
  const std::string name = ini_.ReadBootIni(BootIni::DeviceListSection, identity);
  facts_ = "identity " + identity + "\ndevice " + (name.empty() ? "unknown" : name) + "\nversion " +
           (version.empty() ? "unknown" : version) + "\n";
  return std::stoi(identity);
}

bool DeviceSession::FindDevice() {
  std::string section = options_.DeviceName;
  if (section.empty()) {
    const std::string identity = comms_.ReadDeviceId();
    section = ini_.ReadBootIni(BootIni::DeviceListSection, identity);
    if (section.empty() && StopAsked()) {
      return false;
    }
    if (section.empty()) {
      Complain(identity == "0" ? std::string("the device does not tell its identity; --device names it")
                               : identity + " is the identity of no device in P24qp.ini; --device names one");
      return false;
    }
  }
  comms_.Device = ReadPicDevice(ini_, section, comms_.Settings);
  if (comms_.Device.BytesPerAddr == 0) {
    Complain("P24qp.ini does not describe a device " + section);
    return false;
  }
  if (options_.Command == "write" && hasEeData_ && comms_.Device.DeviceType != HasEeprom &&
      !options_.DespiteWarnings) {
    Complain("the file has data for an EEPROM that the device lacks (--despite-warnings leaves it out)");
    return false;
  }
  return true;
}

std::int32_t DeviceSession::Erase() {
  std::uint32_t end = comms_.Device.PmRangeHigh;
  if (comms_.Device.DeviceType == HasConfigAtEnd && options_.KeepConfig) {
    end -= LastPage;
  }
  if (StopAsked()) {
    return PicCode::Aborted;
  }
  state_ = State::PartlyErased;
  return comms_.EraseRangeDevice(static_cast<std::int32_t>(comms_.Device.PmRangeLow),
                                 static_cast<std::int32_t>(end));
}

std::int32_t DeviceSession::Write() {
  if (StopAsked()) {
    return PicCode::Aborted;
  }
  state_ = State::PartlyWritten;
  std::int32_t code = comms_.WriteRangeDevice(comms_.Device.WriteBlock, comms_.Device.BytesPerAddr,
                                              PicCommand::WriteFlash, images_.ProgMem());
  if (code == PicCode::Done && hasEeData_ && comms_.Device.DeviceType == HasEeprom) {
    code = comms_.WriteRangeDevice(1, 1, PicCommand::WriteEeprom, images_.EeData());
  }
  if (code == PicCode::NotAsFile) {
    PrintDifferences();
  }
  if (code != PicCode::Done) {
    return code;
  }
  state_ = State::Unconfirmed;
  const std::int32_t confirmed = comms_.SendVerifyOk();
  return confirmed < 0 ? confirmed : PicCode::Done;
}

std::int32_t DeviceSession::Verify() {
  if (StopAsked()) {
    return PicCode::Aborted;
  }
  std::int32_t code = comms_.CompareRangeDevice(comms_.Device.WriteBlock, comms_.Device.BytesPerAddr,
                                                PicCommand::WriteFlash, images_.ProgMem());
  if (code == PicCode::NotAsFile) {
    PrintDifferences();
  }
  if (code == PicCode::Done && hasEeData_ && comms_.Device.DeviceType == HasEeprom) {
    code = comms_.CompareRangeDevice(1, 1, PicCommand::WriteEeprom, images_.EeData());
    if (code == PicCode::NotAsFile) {
      PrintDifferences();
    }
  }
  return code;
}

bool DeviceSession::StopAsked() const {
  return parts_.StopRequests() > 0;
}

void DeviceSession::ObeyStop() {
  if (StopAsked()) {
    comms_.RunFlag = 0;
  }
}

void DeviceSession::PrintDifferences() {
  const std::string log = parts_.Tool.Disk.Read(images_.PathOf(images_.Log()));
  const auto count = static_cast<std::size_t>(std::count(log.begin(), log.end(), '\n'));
  std::size_t shown = 0;
  for (LineReader lines(log); !lines.AtEnd() && shown < MostDifferences; ++shown) {
    Complain(std::string(lines.Next()));
  }
  if (count > shown) {
    Complain("... and " + std::to_string(count - shown) + " more");
  }
}

void DeviceSession::TellState(std::int32_t code) const {
  if (code == PicCode::Done || options_.Command == "identify" || options_.Command == "run") {
    return;
  }
  switch (state_) {
    case State::Untouched:
      Complain("the device is as it was");
      break;
    case State::PartlyErased:
      Complain("the device's program may be erased in part; erase again before a program is written");
      break;
    case State::PartlyWritten:
      Complain("the device holds no whole program and stays in its boot loader; erase it and write again");
      break;
    case State::Unconfirmed:
      Complain("the device holds the whole program but did not confirm it; write again");
      break;
  }
}
