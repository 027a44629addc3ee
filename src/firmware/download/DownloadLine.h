#pragma once

#include <chrono>
#include <cstdint>
#include <functional>
#include <optional>
#include <span>
#include <string>
#include <string_view>

#include "core/line/SerialJob.h"
#include "firmware/download/FirmwareEnd.h"
#include "firmware/download/FirmwareRecord.h"
#include "platform/EventPump.h"
#include "platform/MessageBoxes.h"
#include "platform/SerialPort.h"

/// What the operator asked for during a download.
struct DownloadFlags {
  bool AbortRequested = false;
  bool Closing = false;  ///< the window goes, and its port is closed already
};

/// The end of the download, or nothing when it goes on.
using DownloadStep = std::optional<FirmwareEnd>;

/// An awaited character, unless the download ends.
struct DownloadReply {
  DownloadStep End;
  char Character = 0;
};

/// The line of one download: single characters to and from the boot code of a device. What fails on the line
/// is thrown as RuntimeError, except where the operator is told by a box of its own.
class DownloadLine {
 public:
  static constexpr const char* Settings = "19200,n,8,1";

  /// For each reply, from the moment the last byte was handed over.
  static constexpr std::chrono::milliseconds ReplyLimit{10000};

  /// All must outlive this object.
  DownloadLine(SerialPort& port, EventPump& events, MessageBoxes& boxes, const DownloadFlags& flags,
               FirmwareRecord& record);

  /// Throws as SerialPort::Open does.
  void Open(const std::string& device) { job_.Open(device, Settings); }
  void Close() { job_.Close(); }
  /// The port outlives this object open, unless the line failed.
  void LeaveOpen() { job_.LeaveOpen(); }

  /// Lets pending events run, then looks whether the download must end.
  DownloadStep CheckAbort();
  /// Whether it must end by what happened so far, without letting events run.
  DownloadStep Ended() const;

  DownloadStep SendString(std::string_view text);
  /// Sends bytes one at a time and lets events run after each. The packet is sent whole even if the operator
  /// stops the download.
  void SendBytes(std::span<const std::uint8_t> bytes);
  void SendByte(std::uint8_t byte);

  /// Waits for a device that announces itself by "BOOT", however long. Letters between these four are lost on
  /// it, but not other characters: it never sees an announcement after a stray "B", "O" or "T".
  DownloadStep AwaitAnnouncement();

  /// What decides when the operator's stop and the awaited character come together.
  enum class First { Abort, Character };

  /// Waits for one of the characters in `wanted` and drops all others.
  DownloadReply Await(std::string_view wanted, First first = First::Character);

  /// Sends `command` and waits for `answer`.
  DownloadStep Ask(std::string_view command, std::string_view answer);

  /// Waits for any character, the reply to a packet.
  DownloadReply AwaitReply();

  /// Notes a reply other than the good one.
  void NoteBadReply(const std::string& toWhat, char reply) { record_.BadAnswer(toWhat, reply); }

 private:
  std::optional<char> ReadChar();
  /// Waits until `arrived` is true or the operator stops the download.
  DownloadStep Wait(const std::function<bool()>& arrived, First first, std::chrono::milliseconds limit);
  FirmwareEnd Stopped() const;
  /// Tells of a fault of the line; throws if the line was lost.
  FirmwareEnd TellOfFault();

  SerialJob job_;
  EventPump& events_;
  MessageBoxes& boxes_;
  const DownloadFlags& flags_;
  FirmwareRecord& record_;
};
