#pragma once

#include <array>

#include "sim/line/DeviceFailure.h"

namespace sim {

/// What can go wrong between a PIC24F bootloader and its host.
enum class Pic24fFailure {
  None,
  Silence,
  LostAnswer,
  LostRequest,
  WrongChecksum,
  OtherCommand,
  ShortRead,
  CutAnswer,
  TornAnswers,
  EscapedAnswers,
  LateAnswer,
  DoubleAnswer,
  Noise,
  FalseStart,
  BadCells,
  LostRow,
  RefusedErase,
  UnknownIdentity,
  UnpluggedInAnswer,
  UnpluggedInWrite,
};

using Pic24fFailureInfo = FailureInfo<Pic24fFailure>;

/// Answers, requests and rows are counted from the loader's start, repeated ones included.
inline constexpr std::array<Pic24fFailureInfo, 20> Pic24fFailures{{
    {Pic24fFailure::None, "none", FailurePlace::None, "a faultless loader"},
    {Pic24fFailure::Silence, "silence", FailurePlace::Answer, "answer K and all behind it stay away"},
    {Pic24fFailure::LostAnswer, "lost-answer", FailurePlace::Answer, "answer K stays away"},
    {Pic24fFailure::LostRequest, "lost-request", FailurePlace::Frame, "request K does not reach the loader"},
    {Pic24fFailure::WrongChecksum, "wrong-checksum", FailurePlace::Answer, "a wrong checksum in answer K"},
    {Pic24fFailure::OtherCommand, "other-command", FailurePlace::Answer,
     "answer K is one to another command"},
    {Pic24fFailure::ShortRead, "short-read", FailurePlace::Answer,
     "if answer K is one to a read: only half of the bytes, and a checksum that fits"},
    {Pic24fFailure::CutAnswer, "cut-answer", FailurePlace::Answer, "the second half of answer K stays away"},
    {Pic24fFailure::TornAnswers, "torn-answers", FailurePlace::None, "bytes in small pieces with pauses"},
    {Pic24fFailure::EscapedAnswers, "escaped-answers", FailurePlace::None,
     "every byte of the answers is escaped, which is unusual but correct"},
    {Pic24fFailure::LateAnswer, "late-answer", FailurePlace::Answer, "answer K comes 3 s late"},
    {Pic24fFailure::DoubleAnswer, "double-answer", FailurePlace::Answer, "answer K comes twice"},
    {Pic24fFailure::Noise, "noise", FailurePlace::Answer, "line noise before answer K"},
    {Pic24fFailure::FalseStart, "false-start", FailurePlace::Answer,
     "line noise that looks like the start of a packet, before answer K"},
    {Pic24fFailure::BadCells, "bad-cells", FailurePlace::Row,
     "an instruction in the middle of row K comes out as zeros"},
    {Pic24fFailure::LostRow, "lost-row", FailurePlace::Row, "row K is acknowledged but not programmed"},
    {Pic24fFailure::RefusedErase, "refused-erase", FailurePlace::None, "an erase does nothing, unanswered"},
    {Pic24fFailure::UnknownIdentity, "unknown-identity", FailurePlace::None,
     "a device of identity 32766, which none has"},
    {Pic24fFailure::UnpluggedInAnswer, "unplugged-in-answer", FailurePlace::Answer,
     "the line is pulled out in the middle of answer K"},
    {Pic24fFailure::UnpluggedInWrite, "unplugged-in-write", FailurePlace::Row,
     "the line is pulled out when half of row K is programmed"},
}};
static_assert(IsInOrder(Pic24fFailures));

}  // namespace sim
