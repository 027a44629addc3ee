#include "core/line/Transcript.h"

#include <algorithm>
#include <array>
#include <cstdio>
#include <utility>

namespace {

constexpr std::size_t MostWaitingBytes = 16384;
constexpr std::size_t RememberedConversations = 4;

}  // namespace

Transcript::Transcript(std::function<void(const std::string& rows)> write, std::string instrument,
                       const MonotonicClock& time, Repeats repeats)
    : time_(time), repeats_(repeats), write_(std::move(write)), instrument_(std::move(instrument)) {}

Transcript::Transcript(const LogRing& ring, std::string instrument, const MonotonicClock& time,
                       Repeats repeats)
    : Transcript([ring = ring](const std::string& rows) mutable { ring.Append(rows); }, std::move(instrument),
                 time, repeats) {}

Transcript::~Transcript() {
  EndRow();
  Write();
}

void Transcript::BeginRow(char direction) {
  EndRow();
  rowDirection_ = direction;
}

void Transcript::EndRow(std::string_view note) {
  if (rowSize_ == 0) {
    return;
  }
  constexpr std::string_view digits = "0123456789ABCDEF";
  rows_ += RowStart(rowTime_, rowDirection_ == '>' ? "->" : "<-");
  for (std::size_t i = 0; i < rowSize_; ++i) {
    const std::array<char, 3> text{' ', digits[row_[i] >> 4U], digits[row_[i] & 15U]};
    rows_.append(text.data(), text.size());
  }
  if (repeats_ == Repeats::Counted) {
    for (std::size_t i = 0; i < rowSize_; ++i) {
      passed_.append(
          {rowDirection_, static_cast<char>(row_[i])});  // where rows part is a matter of time alone
    }
  }
  rowSize_ = 0;
  FinishRow(note);
}

void Transcript::Note(std::string_view note, std::string_view detail) {
  EndRow();
  rows_ += RowStart(time_.Elapsed(), "--");
  FinishRow(note, detail);
}

void Transcript::End() {
  EndRow();
  const bool repeats = repeats_ == Repeats::Counted && isWhole_ &&
                       std::find(previous_.begin(), previous_.end(), passed_) != previous_.end();
  if (repeats) {
    rows_.clear();
    ++repeatCount_;
    repeatTime_ = time_.Elapsed();
  } else {
    Write();
  }
  isWhole_ = true;
  if (repeats_ == Repeats::Counted) {
    previous_.push_back(std::exchange(passed_, {}));
    if (previous_.size() > RememberedConversations) {
      previous_.pop_front();
    }
  }
}

std::string Transcript::RowStart(std::chrono::microseconds time, std::string_view direction) const {
  std::array<char, 32> seconds{};
  std::snprintf(seconds.data(), seconds.size(), "%12.6f ", std::chrono::duration<double>(time).count());
  return std::string(seconds.data()).append(instrument_).append(" ").append(direction);
}

void Transcript::FinishRow(std::string_view note, std::string_view detail) {
  for (const std::string_view text : {note, detail}) {
    if (!text.empty()) {
      rows_.append(" ").append(text);
    }
  }
  rows_ += '\n';
  if (repeats_ == Repeats::Counted) {
    passed_.append(note);
  }
  if (rows_.size() > MostWaitingBytes) {
    Write();
    isWhole_ = false;
  }
}

std::string Transcript::RepeatsRow() {
  if (repeatCount_ == 0) {
    return {};
  }
  const int count = std::exchange(repeatCount_, 0);
  return RowStart(repeatTime_, "--") + " the last ones again, " + std::to_string(count) +
         (count == 1 ? " time\n" : " times\n");
}

void Transcript::Write() {
  write_(RepeatsRow() + rows_);
  rows_.clear();
}
