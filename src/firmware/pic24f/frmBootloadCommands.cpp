// The commands of the tool bar.

#include <QGuiApplication>
#include <QScopeGuard>
#include <sstream>

#include "core/text/Filled.h"
#include "firmware/hex/HexText.h"
#include "firmware/pic24f/PicFrame.h"
#include "firmware/pic24f/frmBootload.h"
#include "ui_frmBootload.h"

namespace {

constexpr std::int16_t HasConfigAtEnd = 2;  ///< a device type
constexpr std::uint32_t LastPage = 1024;    ///< device addresses

constexpr std::size_t Flash = 0;  ///< items of M_MemAccess
constexpr std::size_t EeData = 1;

std::vector<std::string> WordsOf(const std::string& text) {
  std::istringstream stream(text);
  return {std::istream_iterator<std::string>(stream), {}};
}

}  // namespace

/// The position that is asked is that of "Run".
void frmBootload::ConnectOrDisconnect() {
  if (ui_->Run->isChecked()) {
    ConnectDevice();
  } else {
    DisconnectDevice();
  }
}

void frmBootload::ConnectDevice() {
  try {
    if (comms_.PortHandle <= 0) {
      comms_.PortHandle = library_->OpenPIC(comms_.PortName, comms_.BitRate, comms_.Settings.CommTimeOut);
    }
    if (comms_.PortHandle < 0) {
      SetStatus("Failed to open port...");
      ui_->Run->setChecked(false);
      return;
    }
    ui_->StatusPanel3->setText(QString::fromStdString(comms_.ReadBootVersion()));
    if (ui_->StatusPanel3->text().isEmpty()) {
      SetStatus("No firmware version available...");
    }
    FindDevice();
    resetVectorText_ = comms_.ReadResetVector();
    if (resetVectorText_.empty()) {
      SetStatus("Reset Vector not read");
    }
    ListConfigBytes();
    ui_->StatusPanel2->setText(QString::fromStdString(deviceName_));
    SetStatus("Device found...");
    SetUiState(1);
  } catch (const RuntimeError& error) {
    ForgetLostPort(error);
    SetStatus(std::string("Core error:  ") + error.what());
  }
}

void frmBootload::FindDevice() {
  if (comms_.Settings.DeviceMode == 0) {
    deviceName_ = ini_.ReadBootIni(BootIni::DeviceListSection, comms_.ReadDeviceId());
  }
  comms_.Device = ReadPicDevice(ini_, deviceName_, comms_.Settings);
}

void frmBootload::ListConfigBytes() {
  Selector().ClearConfigBytes();
  constexpr std::uint32_t lastAddress = 0xFFFFFF;  // the keys have six digits
  const std::uint32_t high = std::min(comms_.Device.CfgRangeHigh, lastAddress);
  for (std::uint32_t address = comms_.Device.CfgRangeLow; address <= high; ++address) {
    const std::string name = ini_.ReadBootIni(deviceName_, FormatHex(address, 6));
    if (!name.empty()) {
      Selector().AddConfigByte(name, address);
    }
  }
}

void frmBootload::DisconnectDevice() {
  comms_.RunFlag = 0;
  parts_.Events.DoEvents();
  if (comms_.PortHandle > 0) {
    library_->ClosePIC(comms_.PortHandle);
    comms_.PortHandle = -1;
  }
  ui_->Connect->setChecked(false);
  SetStatus("Not connected...");
  ui_->StatusPanel2->setText(QStringLiteral(" "));
  SetUiState(0);
}

void frmBootload::Operate(const std::function<void()>& operation) {
  QGuiApplication::setOverrideCursor(Qt::BusyCursor);
  const auto restore = qScopeGuard([this] {
    SetUiState(1);
    QGuiApplication::restoreOverrideCursor();
  });
  SetUiState(2);
  try {
    operation();
  } catch (const RuntimeError& error) {
    ForgetLostPort(error);
    throw;
  }
}

/// The library closes a port whose line is lost; the next connection opens it anew.
void frmBootload::ForgetLostPort(const RuntimeError& error) {
  if (error.Number() == Fault::PortLost || error.Number() == Fault::PortNotOpen) {
    library_->ClosePIC(comms_.PortHandle);
    comms_.PortHandle = -1;
  }
}

void frmBootload::Write() {
  bool differs = false;
  Operate([&] { differs = !WriteMemories(); });
  if (differs) {
    ShowLog();
  }
}

bool frmBootload::WriteMemories() {
  bool failed = false;
  const auto write = [&](std::int16_t blockSize, std::uint8_t bytesPerAddress, std::uint8_t command,
                         const std::string& image) {
    const std::int32_t code = comms_.WriteRangeDevice(blockSize, bytesPerAddress, command, image);
    failed = failed || (code != PicCode::Done && code != PicCode::NotAsFile && code != PicCode::Aborted);
    SetStatus(code == PicCode::NotAsFile ? "Verify error received..."
              : code == PicCode::Aborted ? "Operation aborted..."
              : code == PicCode::Done    ? "Finished operation..."
                                         : "Failed to write device...");
    return code;
  };
  std::int32_t code = PicCode::Done;
  if (menus_.M_MemAccess[Flash]->isChecked()) {
    code = write(comms_.Device.WriteBlock, comms_.Device.BytesPerAddr, PicCommand::WriteFlash,
                 comms_.Settings.ProgMem);
  }
  if (code != PicCode::NotAsFile && code != PicCode::Aborted && menus_.M_MemAccess[EeData]->isChecked()) {
    code = write(1, 1, PicCommand::WriteEeprom, comms_.Settings.EeData);
  }
  if (code == PicCode::NotAsFile || code == PicCode::Aborted) {
    return code == PicCode::Aborted;
  }
  if (!failed && comms_.SendVerifyOk() < 0) {
    SetStatus("Verify Ok command failed...");
  }
  return true;
}

void frmBootload::ShowLog() {
  const std::string log = parts_.Folder.ForWriting(comms_.Settings.ErrorLog);
  std::vector<std::string> words = WordsOf(comms_.Settings.Editor);
  words.push_back(log);
  try {
    parts_.OtherPrograms.Start(words);
  } catch (const RuntimeError&) {
    SetStatus(Filled(parts_.Strings.Text(OwnText::LogEditorNotStarted), {log}));
  }
}

void frmBootload::Erase() {
  Operate([this] {
    if (!menus_.M_MemAccess[Flash]->isChecked()) {
      return;
    }
    std::uint32_t end = comms_.Device.PmRangeHigh;
    if (comms_.Device.DeviceType == HasConfigAtEnd) {
      const BoxAnswer answer = parts_.Boxes.Show("Erase Flash Configuration Word?", DefaultBoxTitle,
                                                 BoxIcon::None, BoxButtons::YesNoCancel);
      if (answer == BoxAnswer::Cancel) {
        SetStatus("Operation aborted...");
        return;
      }
      end -= answer == BoxAnswer::No ? LastPage : 0;
    }
    const std::int32_t code = comms_.EraseRangeDevice(static_cast<std::int32_t>(comms_.Device.PmRangeLow),
                                                      static_cast<std::int32_t>(end));
    SetStatus(code == PicCode::Aborted ? "Operation aborted..."
              : code == PicCode::Done  ? "Finished operation..."
                                       : "Failed to write device...");
  });
}

void frmBootload::RunDevice() {
  try {
    comms_.ResetDevice();
  } catch (const RuntimeError& error) {
    ForgetLostPort(error);
    throw;
  }
  DisconnectDevice();
  SetStatus("Run mode is set...");
}
