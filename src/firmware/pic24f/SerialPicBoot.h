#pragma once

#include <chrono>
#include <functional>
#include <optional>
#include <string>
#include <vector>

#include "core/line/SerialJob.h"
#include "platform/EventPump.h"
#include "platform/PicBoot.h"
#include "platform/SerialPort.h"

/// The boot loader's library over a serial line of the machine. Only an answer to the packet just sent
/// counts: its first byte is the command, and a read repeats the five bytes of its request. Anything else
/// that comes in is passed over, and what came before a packet is sent is dropped.
///
/// An operation waits for the time-out, and besides for as long as its bytes take on the line and the
/// device's memory needs. An answer that comes in slowly is waited for as long as it goes on.
class SerialPicBoot final : public PicBoot {
 public:
  struct Parts {
    SerialPort& Port;
    EventPump& Events;
    /// The device of a port's name. May throw RuntimeError, as an unknown port does.
    std::function<std::string(const std::string& port)> DeviceOf;
    /// Asked during waits: true if they must end. May be empty.
    std::function<bool()> Stopped = {};
  };

  /// Results of operations that fail.
  static constexpr std::int32_t NoPort = -1;         ///< it does not open, or is not open
  static constexpr std::int32_t NoAnswer = -2;       ///< none came, whatever was sent again
  static constexpr std::int32_t ShortAnswer = -3;    ///< a read never gave all that was asked for
  static constexpr std::int32_t InvalidRecord = -4;  ///< no such packet: no block, too many, or no room
  static constexpr std::int32_t Ended = -5;          ///< stopped, or the program is closing
  static constexpr std::int32_t NotEqual = -6;       ///< of VerifyPIC

  /// A packet is never sent more often than this again.
  static constexpr std::int32_t MostRetries = 20;

  explicit SerialPicBoot(Parts parts);

  std::int32_t OpenPIC(const std::string& port, std::int32_t bitRate, std::int32_t timeOut) override;
  void ClosePIC(std::int32_t handle) override;
  void SendPacket(std::int32_t handle, std::span<const std::uint8_t> packet) override;
  std::int32_t GetPacket(std::int32_t handle, std::span<std::uint8_t> buffer) override;
  std::int32_t SendGetPacket(std::int32_t handle, std::span<std::uint8_t> buffer, std::size_t length,
                             std::size_t longest, std::int32_t retries) override;
  std::int32_t ReadPIC(std::int32_t handle, const PicRecord& record, std::span<std::uint8_t> buffer) override;
  std::int32_t WritePIC(std::int32_t handle, const PicRecord& record,
                        std::span<const std::uint8_t> bytes) override;
  std::int32_t VerifyPIC(std::int32_t handle, const PicRecord& record,
                         std::span<const std::uint8_t> bytes) override;
  std::int32_t ErasePIC(std::int32_t handle, std::uint32_t address, std::int32_t blocks,
                        std::int32_t retries) override;

 private:
  using Bytes = std::vector<std::uint8_t>;
  using Milliseconds = std::chrono::milliseconds;

  /// A packet and the answer that is due.
  struct Request {
    Bytes Packet;
    std::size_t Longest;      ///< bytes of the answer
    std::size_t Due = 1;      ///< bytes that it must have at least
    std::size_t Repeats = 1;  ///< bytes of the packet that it begins with
    std::int32_t Retries = 0;
    Milliseconds Work{0};  ///< that the device's memory needs
  };

  bool IsOpen(std::int32_t handle) const { return job_ && handle == handle_; }
  /// Sends until the answer is there. Returns its length or a negative number.
  std::int32_t Exchange(const Request& request);
  /// Waits for one answer, which is then in `answer_`.
  LineWait Await(std::size_t longest, Milliseconds limit, const std::function<bool(const Bytes&)>& isDue);
  void Send(std::span<const std::uint8_t> packet);
  Milliseconds LineTime(std::size_t dataBytes) const;
  /// The result of a wait that came to an end without an answer. Throws when the line was lost.
  std::int32_t GiveUp(LineWait wait);

  const Parts parts_;
  std::optional<SerialJob> job_;  ///< while the port is open
  std::int32_t handle_ = 0;       ///< of the port opened last
  std::int32_t bitRate_ = 1;
  Milliseconds timeOut_{0};
  Bytes answer_;
};
