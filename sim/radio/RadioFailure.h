#pragma once

#include <array>
#include <optional>
#include <string_view>

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
};

struct RadioFailureInfo {
  RadioFailure Failure;
  std::string_view Name;                ///< for command lines and test names
  std::optional<GunCommand> Concerned;  ///< the one command whose answers it strikes; none: all
  std::string_view Meaning;
};

/// Every failure once, in the order of the enumeration.
inline constexpr std::array<RadioFailureInfo, 26> RadioFailures{{
    {RadioFailure::None, "none", std::nullopt, "faultless answers"},
    {RadioFailure::SilentGun, "silent-gun", std::nullopt, "no answer at all"},
    {RadioFailure::LostSize, "lost-size", GunCommand::Size, "no answer to command 1"},
    {RadioFailure::LostBlock, "lost-block", GunCommand::Block, "no answer to command 2"},
    {RadioFailure::LostClose, "lost-close", GunCommand::Close, "no answer to command 3"},
    {RadioFailure::BadChecksum, "bad-checksum", std::nullopt, "a wrong checksum in the frame"},
    {RadioFailure::OtherSlot, "other-slot", GunCommand::Search,
     "the search answer comes when the next id is searched"},
    {RadioFailure::OtherBlock, "other-block", GunCommand::Block,
     "another block than asked for (of a lone block: under the next one's offset)"},
    {RadioFailure::StaleAnswer, "stale-answer", std::nullopt, "the gun's answer before comes again instead"},
    {RadioFailure::DoubleAnswer, "double-answer", std::nullopt, "the answer comes twice"},
    {RadioFailure::StatusFrames, "status-frames", std::nullopt,
     "a transmit status frame before and a modem status frame behind the answer"},
    {RadioFailure::TornFrames, "torn-frames", std::nullopt, "bytes in small pieces with pauses"},
    {RadioFailure::CutFrames, "cut-frames", std::nullopt, "the second half of the frame stays away"},
    {RadioFailure::StartForChecksum, "start-for-checksum", std::nullopt, "0x7E in place of the checksum"},
    {RadioFailure::LostChecksum, "lost-checksum", std::nullopt,
     "the frame without its checksum, and at once the whole frame"},
    {RadioFailure::WrongCrc, "wrong-crc", GunCommand::Block, "a first block that belies the check byte"},
    {RadioFailure::Noise, "noise", std::nullopt, "line noise before the answer"},
    {RadioFailure::FalseStart, "false-start", std::nullopt, "line noise that looks like a frame's start"},
    {RadioFailure::HangUpInSearch, "hang-up-in-search", GunCommand::Search,
     "the modem is pulled out in the middle of a search answer"},
    {RadioFailure::HangUpInBlock, "hang-up-in-block", GunCommand::Block,
     "the modem is pulled out in the middle of a block"},
    {RadioFailure::TotalZero, "total-zero", GunCommand::Size, "a total of 0 bytes"},
    {RadioFailure::TotalAbove270, "total-above-270", std::nullopt, "scores of more than 270 bytes"},
    {RadioFailure::LowPlayerId, "low-player-id", std::nullopt, "an answer from a player id below 32"},
    {RadioFailure::LongData, "long-data", std::nullopt, "300 data bytes in the frame"},
    {RadioFailure::LongPayload, "long-payload", std::nullopt, "a packet that claims 255 payload bytes"},
    {RadioFailure::LongAtResponse, "long-at-response", std::nullopt,
     "an AT response with 30 value bytes before the answer"},
}};

}  // namespace sim
