#include "sim/recorder/RecorderTrouble.h"

#include <stdexcept>

namespace sim {
namespace {

constexpr std::uint8_t Noise = 0xFE;

const RecorderFailureInfo& InfoOf(RecorderFailure failure) {
  return RecorderFailures.at(static_cast<std::size_t>(failure));
}

}  // namespace

RecorderTrouble::RecorderTrouble(RecorderFailure failure, std::size_t place)
    : failure_(failure), place_(place) {
  const FailurePlace kind = InfoOf(failure).Place;
  if (kind != FailurePlace::None && place == 0) {
    throw std::invalid_argument(kind == FailurePlace::Page ? "There is no page 0" : "There is no answer 0");
  }
}

std::optional<std::vector<std::uint8_t>> RecorderTrouble::Answer(RecorderStep step, std::uint8_t answer) {
  const RecorderFailureInfo& info = InfoOf(failure_);
  if (info.Unanswered == step && (info.Place != FailurePlace::Page || page_ == place_)) {
    return std::nullopt;
  }
  ++answer_;
  using Bytes = std::vector<std::uint8_t>;
  if (failure_ == RecorderFailure::MergedEraseAnswers && step == RecorderStep::Erase) {
    return Bytes{};
  }
  if (failure_ == RecorderFailure::MergedEraseAnswers && step == RecorderStep::EraseEnd) {
    return Bytes{answer, answer};
  }
  if (answer_ != place_) {
    return Bytes{answer};
  }
  switch (failure_) {
    case RecorderFailure::OtherAnswer:
      return Bytes{RecorderRefused};
    case RecorderFailure::DoubleAnswer:
      return Bytes{answer, answer};
    case RecorderFailure::NoiseBeforeAnswer:
      return Bytes{Noise, answer};
    default:
      return Bytes{answer};
  }
}

}  // namespace sim
