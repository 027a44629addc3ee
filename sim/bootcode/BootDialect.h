#pragma once

#include <cstddef>
#include <cstdint>
#include <string>

namespace sim {

/// What the boot code makes of a packet.
struct BootVerdict {
  std::uint8_t Answer;
  std::string Note;     ///< for the log
  std::string Fault{};  ///< to follow "the host"; empty if it did nothing wrong
};

/// The part of a download that differs between the two kinds of devices: from the answer to "P" to the last
/// packet. Collects packets from single bytes.
class BootDialect {
 public:
  enum class Heard { More, Complete, Foreign };

  BootDialect() = default;
  virtual ~BootDialect() = default;
  BootDialect(const BootDialect&) = delete;
  BootDialect& operator=(const BootDialect&) = delete;

  /// The answers to "P" and "B".
  virtual std::uint8_t Product() const = 0;
  virtual std::uint8_t Begun() const = 0;

  /// The device has been switched on.
  virtual void Restart() = 0;
  /// Foreign: the byte begins nothing that is due here, and is dropped.
  virtual Heard Take(std::uint8_t byte) = 0;
  /// Whether the packet that has begun ends when the line falls quiet.
  virtual bool EndsByQuiet() const = 0;
  /// Bytes of the packet that has begun or is complete; 0 also while something else is being collected.
  virtual std::size_t PacketBytes() const = 0;
  /// Whether "F" may come now.
  virtual bool MayFinish() const = 0;

  /// Checks what is complete, and does what it says.
  virtual BootVerdict CarryOut() = 0;
  /// Forgets it instead.
  virtual void Drop() = 0;
};

}  // namespace sim
