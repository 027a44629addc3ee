#pragma once

#include <array>

#include "sim/line/DeviceFailure.h"

namespace sim {

/// What can go wrong at the reader of buttons.
enum class OneWireFailure {
  None,
  Silence,
  NoDetection,
  ShortCircuit,
  ContactLost,
  WrongCrc,
  HangUp,
  NoiseByte,
  TornWrites,
  TwoButtons,
  NoOwnDevice,
  RemovedInRead,
  RemovedInWrite,
  TornCopy,
  DisturbedRead,
  DisturbedWrite,
  WriteProtected,
};

using OneWireFailureInfo = FailureInfo<OneWireFailure>;

/// Bytes are counted from the adapter's start.
inline constexpr std::array<OneWireFailureInfo, 17> OneWireFailures{{
    {OneWireFailure::None, "none", FailurePlace::None, "a faultless adapter"},
    {OneWireFailure::Silence, "silence", FailurePlace::Byte, "answer byte K and all behind it stay away"},
    {OneWireFailure::NoDetection, "no-detection", FailurePlace::None,
     "configuration commands stay unanswered"},
    {OneWireFailure::ShortCircuit, "short-circuit", FailurePlace::None,
     "the bus is shorted, as by a slanted button"},
    {OneWireFailure::ContactLost, "contact-lost", FailurePlace::Bit,
     "buttons lose their contact after K bits of their number, each time"},
    {OneWireFailure::WrongCrc, "wrong-crc", FailurePlace::None,
     "the last bit of each button's number is wrong"},
    {OneWireFailure::HangUp, "hang-up", FailurePlace::Byte,
     "the adapter is pulled out instead of answer byte K"},
    {OneWireFailure::NoiseByte, "noise-byte", FailurePlace::Byte,
     "a byte of line noise before answer byte K"},
    {OneWireFailure::TornWrites, "torn-writes", FailurePlace::None,
     "a pause behind each answer byte, so that answers come late"},
    {OneWireFailure::TwoButtons, "two-buttons", FailurePlace::None,
     "a second button comes and goes with each"},
    {OneWireFailure::NoOwnDevice, "no-own-device", FailurePlace::None,
     "an adapter without an identity of its own"},
    {OneWireFailure::RemovedInRead, "removed-in-read", FailurePlace::Byte,
     "a button leaves behind byte K that is read from a memory"},
    {OneWireFailure::RemovedInWrite, "removed-in-write", FailurePlace::Byte,
     "a button leaves behind byte K of the scratchpad commands (of 43 in a block)"},
    {OneWireFailure::TornCopy, "torn-copy", FailurePlace::Byte,
     "a button leaves when K bytes of a block have got into its memory"},
    {OneWireFailure::DisturbedRead, "disturbed-read", FailurePlace::Byte,
     "byte K that is read from a memory is wrong on the bus"},
    {OneWireFailure::DisturbedWrite, "disturbed-write", FailurePlace::Byte,
     "byte K of the scratchpad commands is wrong on the bus"},
    {OneWireFailure::WriteProtected, "write-protected", FailurePlace::None,
     "no button takes a block into its memory"},
}};
static_assert(IsInOrder(OneWireFailures));

}  // namespace sim
