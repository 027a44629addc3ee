#include "sim/game/ScoreFrame.h"

#include <stdexcept>

#include "sim/line/Crc.h"

namespace sim {
namespace {

constexpr std::size_t CounterBytes = 18;
// Player id and the length byte of the statistics block.
constexpr std::size_t RecordHeadBytes = 2;
// Button id, six words and the flag.
constexpr std::size_t ClosingBytes = 8 + 12 + 1;
constexpr std::size_t LengthWordsBytes = 4;
constexpr std::size_t HitBytes = 3;
// Neither 0 nor a plausible count, so that a reader that mistakes it for data is caught.
constexpr std::uint8_t Filler = 0xEE;

std::uint8_t LowByte(std::size_t word) {
  return static_cast<std::uint8_t>(word & 0xFFU);
}
std::uint8_t HighByte(std::size_t word) {
  return static_cast<std::uint8_t>((word >> 8U) & 0xFFU);
}

class FrameBytes {
 public:
  void Byte(std::uint8_t value) { bytes_.push_back(value); }
  void LowFirst(std::size_t word) {
    Byte(LowByte(word));
    Byte(HighByte(word));
  }
  void HighFirst(std::size_t word) {
    Byte(HighByte(word));
    Byte(LowByte(word));
  }
  void Fill(std::size_t count) { bytes_.insert(bytes_.end(), count, Filler); }
  std::vector<std::uint8_t> CloseWithCrc() {
    Byte(Crc8(bytes_));
    return std::move(bytes_);
  }

 private:
  std::vector<std::uint8_t> bytes_;
};

}  // namespace

std::vector<std::uint8_t> EncodeScoreFrame(const GunScores& scores, const FrameExtras& extras) {
  const std::size_t statisticsLength = CounterBytes + extras.StatisticsBytes;
  const std::size_t recordLength = RecordHeadBytes + statisticsLength + ClosingBytes + extras.RecordBytes;
  const std::size_t frameLength = LengthWordsBytes + recordLength + 1 + HitBytes * scores.Hits.size();
  if (statisticsLength > 0xFF || scores.Hits.size() > 0xFF || frameLength > 0x7FFF) {
    throw std::length_error("A score frame cannot hold this many bytes");
  }

  FrameBytes frame;
  frame.LowFirst(frameLength);
  frame.LowFirst(recordLength);
  frame.Byte(scores.PlayerId);
  frame.Byte(LowByte(statisticsLength));
  for (const std::uint16_t counter :
       {scores.ShotCount, scores.HealCount, scores.AmmoAddCount, scores.AdminKillCount, scores.DeathCount,
        scores.RespawnCount, scores.ExplosiveDamage, scores.RadiationDamage, scores.StunCount}) {
    frame.HighFirst(counter);
  }
  frame.Fill(extras.StatisticsBytes);
  for (const std::uint8_t byte : scores.ButtonId) {
    frame.Byte(byte);
  }
  for (const std::uint16_t word : {scores.RemainingHealth, scores.RemainingClips, scores.RemainingAmmo,
                                   scores.SecondaryDamage, scores.PrimaryDamage, scores.RunCounter}) {
    frame.HighFirst(word);
  }
  frame.Byte(scores.PowerCheatFlag);
  frame.Fill(extras.RecordBytes);
  frame.Byte(LowByte(scores.Hits.size()));
  for (const Hit& hit : scores.Hits) {
    frame.Byte(hit.Shooter);
    frame.LowFirst(hit.Amount);
  }
  return frame.CloseWithCrc();
}

}  // namespace sim
