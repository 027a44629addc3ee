#pragma once

#include <cstddef>
#include <cstdint>
#include <optional>
#include <utility>

#include "platform/RuntimeError.h"
#include "platform/sqlite/KeySet.h"

/// A position among the keys of a dynaset: on a row, before the first, after the last, or in the gap left by
/// a deleted row. Starts on the first row.
class KeyCursor {
 public:
  KeyCursor() = default;
  explicit KeyCursor(KeySet keys) : keys_(std::move(keys)) { MoveFirst(); }

  const KeySet& Keys() const { return keys_; }
  bool Eof() const { return place_ == Place::End || place_ == Place::BothEnds; }
  bool Bof() const { return place_ == Place::Beginning || place_ == Place::BothEnds; }
  bool OnRow() const { return place_ == Place::Row; }
  /// Index of the current row, from 0; in a gap, that of the row after it.
  std::size_t Position() const { return position_; }
  /// Throws RuntimeError 3021 unless on a row.
  std::int64_t Key() const {
    if (!OnRow()) {
      throw RuntimeError(Fault::NoCurrentRecord);
    }
    return keys_.At(position_);
  }

  void MoveTo(std::size_t position) {
    place_ = Place::Row;
    position_ = position;
  }
  void MoveFirst();
  void MoveLast();
  void MoveBehind();
  /// Both throw RuntimeError 3021 if they cannot move any further.
  void MoveNext();
  void MovePrevious();

  /// Adds the key of a new row after the last one; the position does not change.
  void Append(std::int64_t key);
  /// Removes the current row's key, leaving a gap.
  void Erase();

 private:
  enum class Place { Row, Gap, Beginning, End, BothEnds };

  KeySet keys_;
  Place place_ = Place::BothEnds;
  std::size_t position_ = 0;
};
