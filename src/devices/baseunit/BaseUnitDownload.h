#pragma once

#include <cstddef>
#include <cstdint>
#include <optional>
#include <string>

#include "core/game/ScoreFrame.h"
#include "core/line/CommPort.h"
#include "core/line/SerialJob.h"
#include "devices/baseunit/DownloadedGuns.h"
#include "platform/Clock.h"
#include "platform/EventPump.h"
#include "platform/MessageBoxes.h"
#include "platform/SerialPort.h"

/// The small progress window of a transfer. It only displays.
class DownloadProgress {
 public:
  virtual ~DownloadProgress() = default;

  /// Shows the window with its bar at 0 of 224 and the animation stopped.
  virtual void Open() = 0;
  virtual void Close() = 0;
  /// True once the operator has stopped the transfer or closed the window: it must then end silently.
  virtual bool ClosedByOperator() const = 0;

  virtual void SetStatusText(const std::string& text) = 0;
  virtual void SetMaximum(int maximum) = 0;
  /// Moves the bar to `value` and also shows it as a number.
  virtual void SetProgress(int value) = 0;
  virtual void StartTransferAnim() = 0;
};

/// How a download ended.
enum class DownloadEnd {
  Complete,  ///< every frame was taken; also when there was none
  Stopped,   ///< by the operator, by another command that took the line, or by the end of the program
  Failed     ///< no line, no answer in time, a line that was lost, or a frame with a wrong check byte
};

struct DownloadResult {
  DownloadEnd End = DownloadEnd::Failed;
  int Received = 0;  ///< frames taken
  int Expected = 0;  ///< frames that the unit has; 0 when it did not say
};

/// One download of a game from the base unit: single-byte commands out, one length-prefixed frame for each
/// gun back.
///
/// Host to unit: 1, 20 ms pause, 0 asks for scores; 170 accepts a frame; 0 rejects it. Unit to host: the
/// number of frames, then each frame with its check byte, after the reply to the one before.
class BaseUnitDownload {
 public:
  static constexpr const char* LineSettings = "19200,N,8,1";

  BaseUnitDownload(SerialPort& port, CommPort& commPort, EventPump& events, MessageBoxes& boxes,
                   const Clock& clock, DownloadProgress& progress, DownloadedGuns& guns);

  /// Runs the download, message boxes included, and leaves the line closed. Accepted frames are in the game,
  /// however it ended. When another command has closed the line meanwhile, the download ends without a box.
  DownloadResult GetScores();

 private:
  /// False when it broke off.
  bool Transfer();
  bool ReceiveFrame();
  void AcceptFrame();
  void RejectFrame();
  bool ChecksumFits(std::uint8_t crc) const;

  void SendByte(std::uint8_t byte);
  /// The next byte; nothing if the transfer must end: no byte in 5 s, line failure, or a window closed.
  std::optional<std::uint8_t> ReceiveByte();
  void TellOfFault();
  bool Stopped() const;

  CommPort& commPort_;
  EventPump& events_;
  MessageBoxes& boxes_;
  const Clock& clock_;
  DownloadProgress& progress_;
  DownloadedGuns& guns_;
  SerialJob job_;
  ReceiveBuffer buffer_{};
  DownloadResult result_;
  std::size_t length_ = 0;  ///< length word of the current frame, 0 to 32767
};
