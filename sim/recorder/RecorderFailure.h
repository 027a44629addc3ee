#pragma once

#include <array>
#include <optional>

#include "sim/line/DeviceFailure.h"

namespace sim {

/// What the sound recorder answers.
enum class RecorderStep { Start, Erase, EraseEnd, Table, Header, Page, End, Play };

/// What can go wrong at the sound recorder.
enum class RecorderFailure {
  None,
  NoStartAnswer,
  NoEraseAnswer,
  NoEraseEnd,
  NoTableAnswer,
  NoHeaderAnswer,
  NoPageAnswer,
  NoEndAnswer,
  NoPlayAnswer,
  OtherAnswer,
  RefusedPage,
  SlowErase,
  LostByte,
  MergedEraseAnswers,
  DoubleAnswer,
  NoiseBeforeAnswer,
  UnpluggedInErase,
  UnpluggedInPage,
};

struct RecorderFailureInfo : FailureInfo<RecorderFailure> {
  std::optional<RecorderStep> Unanswered = std::nullopt;  ///< the step that the device keeps silent at
};

/// Answers are counted from the recorder's start, each being one byte; pages from the start of a recording,
/// without the table.
inline constexpr std::array<RecorderFailureInfo, 18> RecorderFailures{{
    {{RecorderFailure::None, "none", FailurePlace::None, "a faultless recorder"}},
    {{RecorderFailure::NoStartAnswer, "no-start-answer", FailurePlace::None, "no answer to the start"},
     RecorderStep::Start},
    {{RecorderFailure::NoEraseAnswer, "no-erase-answer", FailurePlace::None,
      "no answer to the erase, which does not begin"},
     RecorderStep::Erase},
    {{RecorderFailure::NoEraseEnd, "no-erase-end", FailurePlace::None, "no answer when the erase is done"},
     RecorderStep::EraseEnd},
    {{RecorderFailure::NoTableAnswer, "no-table-answer", FailurePlace::None,
      "no answer to the page index table"},
     RecorderStep::Table},
    {{RecorderFailure::NoHeaderAnswer, "no-header-answer", FailurePlace::None,
      "no answer to the header of a sound"},
     RecorderStep::Header},
    {{RecorderFailure::NoPageAnswer, "no-page-answer", FailurePlace::Page, "no answer to page K"},
     RecorderStep::Page},
    {{RecorderFailure::NoEndAnswer, "no-end-answer", FailurePlace::None, "no answer to the end"},
     RecorderStep::End},
    {{RecorderFailure::NoPlayAnswer, "no-play-answer", FailurePlace::None,
      "no answer when a sound has ended"},
     RecorderStep::Play},
    {{RecorderFailure::OtherAnswer, "other-answer", FailurePlace::Answer, "answer K is no acknowledgement"}},
    {{RecorderFailure::RefusedPage, "refused-page", FailurePlace::Page,
      "page K is refused, as if its check byte were wrong"}},
    {{RecorderFailure::SlowErase, "slow-erase", FailurePlace::None, "the erase takes 40 s"}},
    {{RecorderFailure::LostByte, "lost-byte", FailurePlace::Page,
      "a byte in the middle of page K does not reach the recorder"}},
    {{RecorderFailure::MergedEraseAnswers, "merged-erase-answers", FailurePlace::None,
      "both answers to the erase come together, when it is done"}},
    {{RecorderFailure::DoubleAnswer, "double-answer", FailurePlace::Answer,
      "answer K comes twice, in one piece"}},
    {{RecorderFailure::NoiseBeforeAnswer, "noise-before-answer", FailurePlace::Answer,
      "a byte of line noise before answer K"}},
    {{RecorderFailure::UnpluggedInErase, "unplugged-in-erase", FailurePlace::None,
      "the line is pulled out during the erase"}},
    {{RecorderFailure::UnpluggedInPage, "unplugged-in-page", FailurePlace::Page,
      "the line is pulled out in the middle of page K"}},
}};
static_assert(IsInOrder(RecorderFailures));

}  // namespace sim
