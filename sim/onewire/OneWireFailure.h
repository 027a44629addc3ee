#pragma once

#include <array>
#include <string_view>

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

/// What the number that goes with a failure counts, from 1.
enum class OneWireFailurePlace { None, Byte, Bit };

struct OneWireFailureInfo {
  OneWireFailure Failure;
  std::string_view Name;  ///< for command lines and test names
  OneWireFailurePlace Place;
  std::string_view Meaning;
};

/// Every failure once, in the order of the enumeration. Answer bytes count from the start of the adapter.
inline constexpr std::array<OneWireFailureInfo, 11> OneWireFailures{{
    {OneWireFailure::None, "none", OneWireFailurePlace::None, "a faultless adapter"},
    {OneWireFailure::Silence, "silence", OneWireFailurePlace::Byte,
     "answer byte K and all behind it stay away"},
    {OneWireFailure::NoDetection, "no-detection", OneWireFailurePlace::None,
     "configuration commands stay unanswered"},
    {OneWireFailure::ShortCircuit, "short-circuit", OneWireFailurePlace::None,
     "the bus is shorted, as by a slanted button"},
    {OneWireFailure::ContactLost, "contact-lost", OneWireFailurePlace::Bit,
     "buttons lose their contact after K bits of their number, each time"},
    {OneWireFailure::WrongCrc, "wrong-crc", OneWireFailurePlace::None,
     "the last bit of each button's number is wrong"},
    {OneWireFailure::HangUp, "hang-up", OneWireFailurePlace::Byte,
     "the adapter is pulled out instead of answer byte K"},
    {OneWireFailure::NoiseByte, "noise-byte", OneWireFailurePlace::Byte,
     "a byte of line noise before answer byte K"},
    {OneWireFailure::TornWrites, "torn-writes", OneWireFailurePlace::None,
     "a pause behind each answer byte, so that answers come late"},
    {OneWireFailure::TwoButtons, "two-buttons", OneWireFailurePlace::None,
     "a second button comes and goes with each"},
    {OneWireFailure::NoOwnDevice, "no-own-device", OneWireFailurePlace::None,
     "an adapter without an identity of its own"},
}};

}  // namespace sim
