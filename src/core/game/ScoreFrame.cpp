#include "core/game/ScoreFrame.h"

#include <string>

#include "core/game/DallasId.h"

namespace {

void AddUnlessOverflow(std::int32_t& sum, std::int32_t amount) {
  std::int32_t result = 0;
  if (!__builtin_add_overflow(sum, amount, &result)) {
    sum = result;
  }
}

/// Reads a frame from start to end.
class FrameReader {
 public:
  explicit FrameReader(const ReceiveBuffer& buffer) : buffer_(buffer) {}

  void MoveTo(std::size_t offset) { offset_ = offset; }

  /// The next byte; nullopt past the buffer's end.
  std::optional<std::uint8_t> Byte() {
    const std::size_t offset = offset_++;
    return offset < buffer_.size() ? std::optional(buffer_[offset]) : std::nullopt;
  }

  std::optional<std::int16_t> HighFirstWord() {
    const auto high = Byte();
    const auto low = Byte();
    return high && low ? MakeWord(*high, *low) : std::nullopt;
  }

  std::optional<std::int16_t> LowFirstWord() {
    const auto low = Byte();
    const auto high = Byte();
    return high && low ? MakeWord(*high, *low) : std::nullopt;
  }

  void AddWord(std::int32_t& field) {
    if (const auto word = HighFirstWord()) {
      AddUnlessOverflow(field, *word);
    }
  }

  void AssignWord(std::int32_t& field) {
    if (const auto word = HighFirstWord()) {
      field = *word;
    }
  }

 private:
  const ReceiveBuffer& buffer_;
  std::size_t offset_ = 0;
};

void ReadCounters(FrameReader& frame, Player& player) {
  for (std::int32_t* counter : {&player.ShotCount, &player.HealCount, &player.AmmoAddCount,
                                &player.AdminKillCount, &player.DeathCount, &player.RespawnCount,
                                &player.ExplosiveDamage, &player.RadiationDamage, &player.StunCount}) {
    frame.AddWord(*counter);
  }
}

std::string ReadDallasId(FrameReader& frame) {
  std::array<std::uint8_t, 8> rom{};
  for (std::uint8_t& byte : rom) {
    byte = frame.Byte().value_or(0);
  }
  return DallasIdOf(rom);
}

void ReadState(FrameReader& frame, Player& player) {
  player.DallasID = ReadDallasId(frame);
  for (std::int32_t* value : {&player.RemainingHealth, &player.RemainingClips, &player.RemainingAmmo,
                              &player.SecondaryDamage, &player.PrimaryDamage, &player.RunCounter}) {
    frame.AssignWord(*value);
  }
  player.PowerCheatFlag = frame.Byte().value_or(player.PowerCheatFlag);
}

void ReadHits(FrameReader& frame, Player& player) {
  const int count = frame.Byte().value_or(0);
  for (int i = 0; i < count; ++i) {
    const auto shooterId = frame.Byte();
    const auto amount = frame.LowFirstWord();
    if (shooterId && amount && OneBased<Player, PlayerCount>::Holds(IndexFromId(*shooterId))) {
      AddUnlessOverflow(player.HitByPlayer(IndexFromId(*shooterId)), *amount);
    }
  }
}

}  // namespace

std::optional<std::int16_t> MakeWord(std::uint8_t high, std::uint8_t low) {
  if (high >= 128) {
    return std::nullopt;
  }
  return static_cast<std::int16_t>(high * 256 | low);
}

void AnalyseData(ReceiveBuffer& buffer, Game& game, const Clock& clock) {
  game.DataPresent = true;
  game.GameDate = clock.ShortDate() + " " + clock.ShortTime();
  const int index = IndexFromId(buffer[4]);
  if (OneBased<Player, PlayerCount>::Holds(index)) {
    const std::size_t recordLength = static_cast<std::size_t>(MakeWord(buffer[3], buffer[2]).value_or(0));
    const std::size_t statisticsLength = buffer[5];
    Player& player = game.Players(index);
    FrameReader frame(buffer);
    frame.MoveTo(6);
    ReadCounters(frame, player);
    frame.MoveTo(6 + statisticsLength);
    ReadState(frame, player);
    frame.MoveTo(4 + recordLength);
    ReadHits(frame, player);
    player.Active = true;
  }
  buffer.fill(0);
}
