#pragma once

#include <cstddef>
#include <cstdint>
#include <span>
#include <vector>

/// The boot loader's packets on the line: STX STX data checksum ETX. The checksum is the two's complement of
/// the sum of the data. A byte of data or checksum that equals one of the three marks has a DLE before it.
namespace PicMark {
inline constexpr std::uint8_t Stx = 0x55;
inline constexpr std::uint8_t Etx = 0x04;
inline constexpr std::uint8_t Dle = 0x05;
}  // namespace PicMark

/// First byte of a packet.
namespace PicCommand {
inline constexpr std::uint8_t Version = 0;  ///< with a length of 0: run the program
inline constexpr std::uint8_t ReadFlash = 1;
inline constexpr std::uint8_t WriteFlash = 2;  ///< counts rows of 64 instructions
inline constexpr std::uint8_t EraseFlash = 3;  ///< counts pages of 512 instructions
inline constexpr std::uint8_t ReadEeprom = 4;  ///< counts words, as does the next
inline constexpr std::uint8_t WriteEeprom = 5;
inline constexpr std::uint8_t ReadConfig = 6;
inline constexpr std::uint8_t WriteConfig = 7;
inline constexpr std::uint8_t VerifyOk = 8;
}  // namespace PicCommand

/// The bytes of a packet on the line.
std::vector<std::uint8_t> PicFrame(std::span<const std::uint8_t> data);

/// Finds packets in what comes in, byte by byte; noise and damaged packets are passed over.
class PicFrameDecoder {
 public:
  /// Longer packets are passed over.
  explicit PicFrameDecoder(std::size_t longest) : longest_(longest) {}

  /// True if the byte completes a packet whose checksum is right.
  bool Receive(std::uint8_t byte);

  /// True if a packet has begun and is not complete.
  bool IsWithin() const { return state_ == State::Inside || state_ == State::Escaped; }

  /// The packet completed last, without its checksum: at least one byte.
  const std::vector<std::uint8_t>& Data() const { return data_; }

 private:
  enum class State { Outside, Begun, Inside, Escaped };

  bool Complete();
  void Add(std::uint8_t byte);

  std::size_t longest_;
  State state_ = State::Outside;
  std::vector<std::uint8_t> bytes_;  ///< of the present packet, with its checksum
  std::vector<std::uint8_t> data_;
};
