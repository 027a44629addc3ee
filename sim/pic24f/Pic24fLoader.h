#pragma once

#include <atomic>
#include <chrono>
#include <cstddef>
#include <cstdint>
#include <optional>
#include <ostream>
#include <string>
#include <string_view>
#include <vector>

#include "sim/line/Device.h"
#include "sim/pic24f/Pic24fMemory.h"
#include "sim/pic24f/Pic24fPacket.h"
#include "sim/pic24f/Pic24fRequest.h"
#include "sim/pic24f/Pic24fTrouble.h"

namespace sim {

struct Pic24fLoaderSettings {
  Pic24fDevice Device = Pic24fDevices[0];
  Pic24fFailure Failure = Pic24fFailure::None;
  std::size_t FailurePlace = 1;  ///< request, answer or row that the failure concerns, from 1
  Pace LinePace = Pace::AsWired;
  std::chrono::microseconds RowTime{0};   ///< to program one
  std::chrono::microseconds PageTime{0};  ///< to erase one
  std::chrono::milliseconds Lateness{3'000};
  std::chrono::milliseconds Patience{1'000};  ///< silence in a packet after which the rest will not come
  std::ostream* Log = nullptr;                ///< receives the traffic in both directions
};

struct Pic24fTraffic {
  std::vector<Pic24fRequest> Requests;  ///< in order of arrival, answered or not
  Pic24fMemory Memory{Pic24fDevices[0]};
  bool IsVerified = false;  ///< the host said so after the last write or erase
  bool Runs = false;        ///< the application, not the loader
};

/// A PIC24F device in its serial bootloader, at any of the usual speeds from 1200 to 115200 baud. Packets
/// with a wrong checksum and requests that the device cannot carry out are not answered. Told to run, it
/// answers nothing more until it is reset.
class Pic24fLoader : public Device {
 public:
  /// Throws std::invalid_argument when the failure has no such place, std::system_error when the system
  /// grants no pseudo terminal. The log must outlive the loader.
  explicit Pic24fLoader(Pic24fLoaderSettings settings);

  Pic24fTraffic Traffic() const { return traffic_.Copy(); }
  /// Waits until `count` requests have come; false when `limit` passes first.
  bool WaitUntilAsked(std::size_t count, std::chrono::milliseconds limit) const;

  /// Back from the application to the loader. For any thread.
  void Reset();

 private:
  using Bytes = std::vector<std::uint8_t>;

  void Run();
  std::optional<std::uint8_t> Read();
  void Take(const Pic24fPacket& packet);
  std::optional<Bytes> CarryOut(const Pic24fRequest& request);
  std::optional<Bytes> AnswerToRead(const Pic24fRequest& request) const;
  bool Change(const Pic24fRequest& request);
  bool WriteProgram(const Pic24fRequest& request);
  void RunApplication();
  void Send(const Pic24fReply& reply);
  void Wait(std::chrono::microseconds duration);
  void Fault(std::string_view what);

  Pic24fLoaderSettings settings_;
  Pic24fTrouble trouble_;
  Pic24fPacketReader reader_;
  TrafficRecord<Pic24fTraffic> traffic_;
  Serving serving_{*this, [this] { Run(); }};
};

}  // namespace sim
