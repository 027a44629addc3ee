#pragma once

#include <array>

#include "sim/line/DeviceFailure.h"

namespace sim {

/// What can go wrong at the reader of membership buttons.
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
};

using OneWireFailureInfo = FailureInfo<OneWireFailure>;

/// Answer bytes are counted from the adapter's start.
inline constexpr std::array<OneWireFailureInfo, 11> OneWireFailures{{
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
}};
static_assert(IsInOrder(OneWireFailures));

}  // namespace sim
