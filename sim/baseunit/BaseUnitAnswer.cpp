#include "sim/baseunit/BaseUnitAnswer.h"

#include <stdexcept>
#include <string>
#include <utility>

#include "sim/game/ScoreFrame.h"

namespace sim {
namespace {

constexpr std::size_t MostFrames = 255;
constexpr std::size_t ExtraStatisticsBytes = 6;
// A gun's frame has at least 46 bytes without its CRC, so these always take it past 1001.
constexpr std::size_t ExtraBytesOfAnOverlongFrame = 1000;

std::vector<std::vector<std::uint8_t>> EncodeAll(const std::vector<GunScores>& game,
                                                 const FrameExtras& extras) {
  std::vector<std::vector<std::uint8_t>> frames;
  frames.reserve(game.size());
  for (const GunScores& scores : game) {
    frames.push_back(EncodeScoreFrame(scores, extras));
  }
  return frames;
}

void RequirePlace(const std::vector<GunScores>& game, BaseUnitFailure failure, std::size_t place) {
  for (const BaseUnitFailureInfo& info : BaseUnitFailures) {
    if (info.Failure == failure && info.Place == FailurePlace::Frame && (place < 1 || place > game.size())) {
      throw std::invalid_argument("There is no frame " + std::to_string(place) + " in an answer of " +
                                  std::to_string(game.size()));
    }
  }
}

// A second run must be distinguishable from the first, so it borrows the figures of the gun that reports
// next.
GunScores SecondRun(const std::vector<GunScores>& game, std::size_t index) {
  GunScores second = game[(index + 1) % game.size()];
  second.PlayerId = game[index].PlayerId;
  return second;
}

void SetHighBits(GunScores& scores) {
  constexpr unsigned highBit = 0x8000;
  for (std::uint16_t* counter : {&scores.ShotCount, &scores.HealCount, &scores.AmmoAddCount,
                                 &scores.AdminKillCount, &scores.DeathCount, &scores.RespawnCount,
                                 &scores.ExplosiveDamage, &scores.RadiationDamage, &scores.StunCount}) {
    *counter = static_cast<std::uint16_t>(*counter | highBit);
  }
}

std::size_t BytesBefore(const BaseUnitAnswer& answer, std::size_t frame) {
  std::size_t bytes = answer.Noise.size() + 1;
  for (std::size_t i = 0; i < frame; ++i) {
    bytes += answer.Frames[i].size();
  }
  return bytes;
}

void CutToSilence(BaseUnitAnswer& answer, std::size_t place) {
  const std::size_t length = BytesBefore(answer, answer.Frames.size());
  if (place < 1 || place > length) {
    throw std::invalid_argument("There is no byte " + std::to_string(place) + " in an answer of " +
                                std::to_string(length));
  }
  answer.CutAfter = place - 1;
  answer.CutBy = BaseUnitAnswer::Cut::Silence;
}

void CutByHangUp(BaseUnitAnswer& answer, std::size_t index) {
  answer.CutAfter = BytesBefore(answer, index) + answer.Frames[index].size() / 2;
  answer.CutBy = BaseUnitAnswer::Cut::HangUp;
}

}  // namespace

BaseUnitAnswer MakeBaseUnitAnswer(std::vector<GunScores> game, BaseUnitFailure failure, std::size_t place) {
  RequirePlace(game, failure, place);
  const std::size_t index = place - 1;
  FrameExtras extras;
  if (failure == BaseUnitFailure::CountZero) {
    game.clear();
  } else if (failure == BaseUnitFailure::LongerStatisticsBlock) {
    extras.StatisticsBytes = ExtraStatisticsBytes;
  } else if (failure == BaseUnitFailure::HighBitWords) {
    SetHighBits(game[index]);
  } else if (failure == BaseUnitFailure::SameGunTwice) {
    game.push_back(SecondRun(game, index));
  }
  if (game.size() > MostFrames) {
    throw std::invalid_argument("The count byte cannot tell more than 255 frames");
  }

  BaseUnitAnswer answer;
  answer.Frames = EncodeAll(game, extras);
  answer.Count = static_cast<std::uint8_t>(game.size());
  if (failure == BaseUnitFailure::WrongCrc) {
    answer.Frames[index].back() ^= 0xFFU;
  } else if (failure == BaseUnitFailure::LengthAbove1001) {
    answer.Frames[index] = EncodeScoreFrame(game[index], {.RecordBytes = ExtraBytesOfAnOverlongFrame});
  } else if (failure == BaseUnitFailure::NoiseBeforeCount) {
    answer.Noise = {0xFE, 0xF0, 0x7F};
  } else if (failure == BaseUnitFailure::TornWrites) {
    answer.Torn = true;
  } else if (failure == BaseUnitFailure::Silence) {
    CutToSilence(answer, place);
  } else if (failure == BaseUnitFailure::HangUp) {
    CutByHangUp(answer, index);
  }
  return answer;
}

}  // namespace sim
