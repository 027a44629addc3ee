#pragma once

#include <functional>
#include <memory>
#include <string>
#include <string_view>

#include "core/text/StringTable.h"
#include "firmware/download/DownloadLine.h"
#include "firmware/download/FirmwareDisplay.h"
#include "firmware/download/FirmwareRecord.h"
#include "firmware/files/FirmwareFile.h"
#include "firmware/files/FirmwareImage.h"
#include "firmware/files/QvmLines.h"
#include "platform/EventPump.h"
#include "platform/Files.h"
#include "platform/MessageBoxes.h"
#include "platform/RuntimeError.h"
#include "platform/SerialPort.h"
#include "platform/WakeLock.h"

/// Moves firmware files into devices over a serial line, one download after the other. A device is ready
/// while its boot code listens, for a moment after it is switched on: the download waits for that.
class FirmwareDownload {
 public:
  /// What it works with; all must outlive it.
  struct Parts {
    SerialPort& MSComm1;
    EventPump& Events;
    MessageBoxes& Boxes;
    const StringTable& Strings;
    WakeLock& Awake;
    FirmwareRecord::Parts Record;
  };

  FirmwareDownload(const Parts& parts, FirmwareDisplay& display);

  /// Runs one download, boxes included. `device` gives the device to open, and may throw. Throws RuntimeError
  /// if the file cannot be loaded (7 for one beyond 8 MB) or the line does not open; nothing was sent then.
  void Run(const std::string& fileName, const std::function<std::string()>& device);

  /// Ends a running download with its box. Without one nothing happens.
  void RequestAbort() { flags_.AbortRequested = true; }

  /// The window goes: the port is closed, and a running download ends with its box.
  void Close();

  /// Back to idle, as after most failures; the port stays as it is.
  void ResetWindow();

 private:
  void Begin();
  /// False if the download ends here, after its box.
  bool Load(FirmwareFileType type, const std::string& fileName);
  bool LoadQvm2File(const std::string& fileName);
  /// The whole file, unless it is too large.
  std::string ReadStart(const std::string& fileName) const;

  /// The conversation over the open line. Returns how it ended, for the record.
  std::string Converse(FirmwareFileType type, DownloadLine& line);
  DownloadStep Transfer(FirmwareFileType type, DownloadLine& line);
  std::string End(FirmwareEnd end, DownloadLine& line);
  /// The end by a run-time failure.
  std::string Fail(const RuntimeError& error, DownloadLine& line);

  void ClosePort();
  void Tell(const std::string& text);
  template <typename... Texts>
  void Advise(Texts... texts);

  const Parts parts_;
  FirmwareDisplay& display_;
  DownloadFlags flags_;
  FirmwareImage image_;
  std::unique_ptr<QvmLines> lines_;
  std::string contents_;  ///< of the file, for the record: its size and checksum
  FirmwareStage stage_ = FirmwareStage::Announcing;
};
