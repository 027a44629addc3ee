#pragma once

#include <cstddef>
#include <cstdint>
#include <optional>
#include <string>

#include "core/game/Game.h"
#include "core/game/ScoreFrame.h"
#include "core/line/CommPort.h"
#include "core/line/SerialJob.h"
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
  /// True once the operator has closed the window: the transfer must then end silently.
  virtual bool ClosedByOperator() const = 0;

  virtual void SetStatusText(const std::string& text) = 0;
  virtual void SetMaximum(int maximum) = 0;
  /// Moves the bar to `value` and also shows it as a number.
  virtual void SetProgress(int value) = 0;
  virtual void StartTransferAnim() = 0;
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
                   const Clock& clock, DownloadProgress& progress, Game& game);

  /// Runs the download, message boxes included, and leaves the line closed. Accepted frames are in the game,
  /// however it ended.
  void GetScores();

 private:
  void Transfer();
  bool ReceiveFrame();
  void AcceptFrame();
  void RejectFrame();
  bool ChecksumFits(std::uint8_t crc) const;

  void SendByte(std::uint8_t byte);
  /// The next byte; nothing if the transfer must end: no byte in 5 s, line failure, or a window closed.
  std::optional<std::uint8_t> ReceiveByte();
  void TellOfFault();

  CommPort& commPort_;
  EventPump& events_;
  MessageBoxes& boxes_;
  const Clock& clock_;
  DownloadProgress& progress_;
  Game& game_;
  SerialJob job_;
  ReceiveBuffer buffer_{};
  std::size_t length_ = 0;  ///< length word of the current frame, 0 to 32767
};
