#pragma once

#include <array>

#include "sim/line/DeviceFailure.h"

namespace sim {

/// What can go wrong on the device's side of a firmware download.
enum class BootFailure {
  None,
  NoiseBeforeBoot,
  StrayLetter,
  BootTwice,
  BootTorn,
  WrongProduct,
  AsksAgain,
  BadAddress,
  UnpluggedInPacket,
  Silence,
  Unplugged,
  OtherReply,
  NoiseBeforeReply,
  DoubleReply,
  LateReply,
};

using BootFailureInfo = FailureInfo<BootFailure>;

/// Replies and packets are counted from the moment at which the device is switched on. BOOT is reply 1;
/// packets are those that erase or write, the ones that are sent again included.
inline constexpr std::array<BootFailureInfo, 15> BootFailures{{
    {BootFailure::None, "none", FailurePlace::None, "a faultless device"},
    {BootFailure::NoiseBeforeBoot, "noise-before-boot", FailurePlace::None,
     "line noise before BOOT, without letters of it"},
    {BootFailure::StrayLetter, "stray-letter", FailurePlace::None, "a B too many before BOOT"},
    {BootFailure::BootTwice, "boot-twice", FailurePlace::None, "BOOT comes twice"},
    {BootFailure::BootTorn, "boot-torn", FailurePlace::None, "BOOT in small pieces with pauses"},
    {BootFailure::WrongProduct, "wrong-product", FailurePlace::None, "the device passes for the other kind"},
    {BootFailure::AsksAgain, "asks-again", FailurePlace::Frame,
     "\"c\" for packet K, and for those behind it as --bootcode-times says"},
    {BootFailure::BadAddress, "bad-address", FailurePlace::Frame, "\"e\" for packet K"},
    {BootFailure::UnpluggedInPacket, "unplugged-in-packet", FailurePlace::Frame,
     "the line is pulled out behind the first byte of packet K"},
    {BootFailure::Silence, "silence", FailurePlace::Byte, "reply K and all behind it stay away (1: BOOT)"},
    {BootFailure::Unplugged, "unplugged", FailurePlace::Byte,
     "the line is pulled out instead of reply K (1: in the midst of BOOT)"},
    {BootFailure::OtherReply, "other-reply", FailurePlace::Byte, "reply K is \"?\""},
    {BootFailure::NoiseBeforeReply, "noise-before-reply", FailurePlace::Byte,
     "a byte of line noise before reply K"},
    {BootFailure::DoubleReply, "double-reply", FailurePlace::Byte, "reply K comes twice"},
    {BootFailure::LateReply, "late-reply", FailurePlace::Byte, "reply K comes late, see --bootcode-late"},
}};
static_assert(IsInOrder(BootFailures));

}  // namespace sim
