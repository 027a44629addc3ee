#pragma once

#include <QDialog>
#include <chrono>
#include <memory>
#include <string>

#include "core/data/IniReader.h"
#include "core/text/StringTable.h"
#include "firmware/download/FirmwareDisplay.h"
#include "firmware/download/FirmwareDownload.h"
#include "platform/Clock.h"
#include "platform/EventPump.h"
#include "platform/FileDialog.h"
#include "platform/Files.h"
#include "platform/MessageBoxes.h"
#include "platform/MonotonicClock.h"
#include "platform/SerialDevices.h"
#include "platform/SerialPort.h"
#include "platform/WakeLock.h"
#include "ui/Commands.h"

namespace Ui {
class FirmwareFlash;
}

/// Loads firmware into a device over a serial cable. If closed during a download, the window goes once that
/// has unwound; Escape does not close it then.
class FirmwareFlash : public QDialog, private FirmwareDisplay {
  Q_OBJECT

 public:
  /// What the window works with; all of it must outlive the window.
  struct Parts {
    SerialPort& MSComm1;
    const SerialDevices& Devices;
    IniReader& Ini;
    EventPump& Events;
    MessageBoxes& Boxes;
    FileDialog& Cd1;
    Files& Disk;
    const Clock& Time;
    const MonotonicClock& Elapsed;
    const StringTable& Strings;
    WakeLock& Awake;
    std::string LogFolder;
  };

  FirmwareFlash(const Parts& parts, QWidget* parent);
  ~FirmwareFlash() override;

  void reject() override;

 private:
  void SetUpLook();
  void FormLoad();
  void ReadSettings();
  void Browse();
  void Download();
  void DescribeFile();
  void CleanUp();

  void SetStatus(const std::string& text) override;
  void SetDownload(const std::string& text) override;
  void SetCurrentBuffer(const std::string& text) override;
  void SetDigits(const std::string& text) override;
  void SetBar(double share) override;
  void SetLamps(bool connected, bool complete) override;
  void SetBreakCaption(const std::string& caption) override;
  void EnableButtons(bool running) override;
  void SetBusy(bool busy) override;
  void SetSent(std::uint64_t sent, std::uint64_t all) override;
  void SetAdvice(const std::string& text) override;

  std::unique_ptr<Ui::FirmwareFlash> ui_;
  const Parts parts_;
  std::int16_t portNumber_ = 0;
  std::string firmwarePath_;                     ///< the last path selected
  std::chrono::microseconds transferBegun_{-1};  ///< when the first data was sent; negative before
  FirmwareDownload download_;
  Commands commands_;
};
