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

/// The small window that follows a transfer. It only shows what it is told.
class TransferProgress {
 public:
  virtual ~TransferProgress() = default;

  /// Shows the window, its bar at 0 of 224, the animation at rest.
  virtual void Open() = 0;
  virtual void Close() = 0;
  /// True when the operator closed the window: the transfer is to end without a word.
  virtual bool ClosedByOperator() const = 0;

  virtual void SetStatusText(const std::string& text) = 0;
  virtual void SetMaximum(int maximum) = 0;
  /// Moves the bar to `value` and shows it as number, too.
  virtual void SetProgress(int value) = 0;
  virtual void StartTransferAnim() = 0;
};

/// One download of a game from the base unit: single-byte commands out, one length-prefixed frame for each
/// gun back.
///
/// Host to unit: 1, 20 ms pause, 0 asks for scores; 170 accepts a frame; 0 rejects it. Unit to host: the
/// number of frames, then each frame with its check byte, the next after the reply to the last.
class BaseUnitDownload {
 public:
  static constexpr const char* LineSettings = "19200,N,8,1";

  BaseUnitDownload(SerialPort& port, CommPort& commPort, EventPump& events, MessageBoxes& boxes,
                   const Clock& clock, TransferProgress& progress, Game& game);

  /// Runs the download with its boxes and leaves the line closed. Frames that came through are in the game,
  /// however it ended.
  void GetScores();

 private:
  void Transfer();
  bool ReceiveFrame();
  void AcceptFrame();
  void RejectFrame();
  bool ChecksumFits(std::uint8_t crc) const;

  void SendByte(std::uint8_t byte);
  /// The next byte; nothing when the transfer has to end: no byte in 5 s, the line lost, or a window closed.
  std::optional<std::uint8_t> ReceiveByte();
  void TellOfFault();

  CommPort& commPort_;
  EventPump& events_;
  MessageBoxes& boxes_;
  const Clock& clock_;
  TransferProgress& progress_;
  Game& game_;
  SerialJob job_;
  ReceiveBuffer buffer_{};
  std::size_t length_ = 0;  ///< L of the frame in hand, 0 to 32767
};
