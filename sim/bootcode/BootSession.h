#pragma once

#include <cstddef>
#include <cstdint>
#include <functional>
#include <optional>
#include <string>
#include <utility>

#include "sim/bootcode/BootDialect.h"

namespace sim {

/// What a byte from the host, or the quiet behind it, has led to.
struct BootStep {
  std::optional<std::uint8_t> Answer{};
  std::string Note{};     ///< for the log
  std::string Fault{};    ///< to follow "the host"; empty if it did nothing wrong
  bool Finished = false;  ///< the download is complete
};

/// The conversation of a download, without the line: "X", "P", "B", packets and "F". It has no beginning
/// until the device is switched on, and none after its end.
class BootSession {
 public:
  /// The answer to packet `number`, counted from 1, if it is not to be looked at.
  using Spoil = std::function<std::optional<std::uint8_t>(std::size_t number)>;

  /// `dialect` must outlive the session.
  BootSession(BootDialect& dialect, Spoil spoil) : dialect_(dialect), spoil_(std::move(spoil)) {}

  void SwitchOn();
  /// None while more bytes of the same packet are due.
  std::optional<BootStep> Take(std::uint8_t byte);
  bool AwaitsQuiet() const { return state_ == State::Packets && dialect_.EndsByQuiet(); }
  /// The line has fallen quiet while this was awaited.
  BootStep Quiet() { return EndOfPacket(); }

  /// Number of the packet that has begun, and how many of its bytes have come; 0 if none has.
  std::size_t Packet() const { return packets_ + 1; }
  std::size_t PacketBytes() const { return state_ == State::Packets ? dialect_.PacketBytes() : 0; }

 private:
  enum class State { Off, Synchronise, Identify, Begin, Packets };

  BootStep Answer(std::uint8_t byte, char due, std::uint8_t answer, State next);
  std::optional<BootStep> TakeOfPacket(std::uint8_t byte);
  BootStep EndOfPacket();

  BootDialect& dialect_;
  Spoil spoil_;
  State state_ = State::Off;
  bool spokenToWhileOff_ = false;
  std::size_t packets_ = 0;
};

}  // namespace sim
