#pragma once

#include <array>
#include <optional>

#include "sim/line/DeviceFailure.h"
#include "sim/radio/GunRequest.h"

namespace sim {

/// What can go wrong between a radio modem's host and a gun.
enum class RadioFailure {
  None,
  SilentGun,
  LostSize,
  LostBlock,
  LostClose,
  BadChecksum,
  OtherSlot,
  OtherBlock,
  StaleAnswer,
  DoubleAnswer,
  StatusFrames,
  TornFrames,
  CutFrames,
  StartForChecksum,
  LostChecksum,
  WrongCrc,
  Noise,
  FalseStart,
  HangUpInSearch,
  HangUpInBlock,
  TotalZero,
  TotalAbove270,
  LowPlayerId,
  LongData,
  LongPayload,
  LongAtResponse,
  NextFrameBegins,
};

struct RadioFailureInfo : FailureInfo<RadioFailure> {
  std::optional<GunCommand> Concerned;  ///< the only command whose answers it strikes; none: all
};

inline constexpr std::array<RadioFailureInfo, 27> RadioFailures{{
    {{RadioFailure::None, "none", FailurePlace::None, "faultless answers"}, std::nullopt},
    {{RadioFailure::SilentGun, "silent-gun", FailurePlace::Gun, "no answer at all"}, std::nullopt},
    {{RadioFailure::LostSize, "lost-size", FailurePlace::Gun, "no answer to command 1"}, GunCommand::Size},
    {{RadioFailure::LostBlock, "lost-block", FailurePlace::Gun, "no answer to command 2"}, GunCommand::Block},
    {{RadioFailure::LostClose, "lost-close", FailurePlace::Gun, "no answer to command 3"}, GunCommand::Close},
    {{RadioFailure::BadChecksum, "bad-checksum", FailurePlace::Gun, "a wrong checksum in the frame"},
     std::nullopt},
    {{RadioFailure::OtherSlot, "other-slot", FailurePlace::Gun,
      "the search answer comes when the next id is searched"},
     GunCommand::Search},
    {{RadioFailure::OtherBlock, "other-block", FailurePlace::Gun,
      "another block than asked for (of a lone block: under the next one's offset)"},
     GunCommand::Block},
    {{RadioFailure::StaleAnswer, "stale-answer", FailurePlace::Gun,
      "the gun's answer before comes again instead"},
     std::nullopt},
    {{RadioFailure::DoubleAnswer, "double-answer", FailurePlace::Gun, "the answer comes twice"},
     std::nullopt},
    {{RadioFailure::StatusFrames, "status-frames", FailurePlace::Gun,
      "a transmit status frame before and a modem status frame behind the answer"},
     std::nullopt},
    {{RadioFailure::TornFrames, "torn-frames", FailurePlace::Gun, "bytes in small pieces with pauses"},
     std::nullopt},
    {{RadioFailure::CutFrames, "cut-frames", FailurePlace::Gun, "the second half of the frame stays away"},
     std::nullopt},
    {{RadioFailure::StartForChecksum, "start-for-checksum", FailurePlace::Gun,
      "0x7E in place of the checksum"},
     std::nullopt},
    {{RadioFailure::LostChecksum, "lost-checksum", FailurePlace::Gun,
      "the frame without its checksum, and at once the whole frame"},
     std::nullopt},
    {{RadioFailure::WrongCrc, "wrong-crc", FailurePlace::Gun, "a first block that belies the check byte"},
     GunCommand::Block},
    {{RadioFailure::Noise, "noise", FailurePlace::Gun, "line noise before the answer"}, std::nullopt},
    {{RadioFailure::FalseStart, "false-start", FailurePlace::Gun,
      "line noise that looks like a frame's start"},
     std::nullopt},
    {{RadioFailure::HangUpInSearch, "hang-up-in-search", FailurePlace::Gun,
      "the modem is pulled out in the middle of a search answer"},
     GunCommand::Search},
    {{RadioFailure::HangUpInBlock, "hang-up-in-block", FailurePlace::Gun,
      "the modem is pulled out in the middle of a block"},
     GunCommand::Block},
    {{RadioFailure::TotalZero, "total-zero", FailurePlace::Gun, "a total of 0 bytes"}, GunCommand::Size},
    {{RadioFailure::TotalAbove270, "total-above-270", FailurePlace::Gun, "scores of more than 270 bytes"},
     std::nullopt},
    {{RadioFailure::LowPlayerId, "low-player-id", FailurePlace::Gun, "an answer from a player id below 32"},
     std::nullopt},
    {{RadioFailure::LongData, "long-data", FailurePlace::Gun, "300 data bytes in the frame"}, std::nullopt},
    {{RadioFailure::LongPayload, "long-payload", FailurePlace::Gun, "a packet that claims 255 payload bytes"},
     std::nullopt},
    {{RadioFailure::LongAtResponse, "long-at-response", FailurePlace::Gun,
      "an AT response with 30 value bytes before the answer"},
     std::nullopt},
    {{RadioFailure::NextFrameBegins, "next-frame-begins", FailurePlace::Gun,
      "the answer, and at once the first 22 bytes of another of 24"},
     std::nullopt},
}};
static_assert(IsInOrder(RadioFailures));

}  // namespace sim
