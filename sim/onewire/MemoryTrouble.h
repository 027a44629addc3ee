#pragma once

#include <cstddef>
#include <cstdint>

namespace sim {

/// What happens to buttons while their memory is read or written.
struct MemoryTroubleSettings {
  enum class Kind {
    None,
    RemovedInRead,
    RemovedInWrite,
    TornCopy,
    DisturbedRead,
    DisturbedWrite,
    WriteProtected
  };

  Kind What = Kind::None;
  std::size_t Place = 1;  ///< byte, from 1, that it concerns
};

/// Counts the bytes that go to and from the memories of all buttons on a bus, and strikes at its place, once.
class MemoryTrouble {
 public:
  explicit MemoryTrouble(MemoryTroubleSettings settings) : settings_(settings) {}

  /// The coming byte of a memory that is read, as it gets through.
  std::uint8_t ThroughRead(std::uint8_t byte) const;
  /// Counts it; true if its button leaves the reader behind it.
  bool EndsRead();

  /// Likewise for the bytes of the commands that write: Write, Read and Copy Scratchpad.
  std::uint8_t ThroughWrite(std::uint8_t byte) const;
  bool EndsWrite();

  bool ForbidsCopy() const { return settings_.What == Kind::WriteProtected; }
  /// How many of `count` bytes get from the scratchpad to the memory; fewer if the button leaves meanwhile.
  std::size_t Copied(std::size_t count);

 private:
  using Kind = MemoryTroubleSettings::Kind;

  MemoryTroubleSettings settings_;
  std::size_t read_ = 0;
  std::size_t written_ = 0;
  bool torn_ = false;
};

}  // namespace sim
