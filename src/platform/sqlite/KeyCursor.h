#pragma once

#include <cstddef>
#include <cstdint>
#include <optional>
#include <utility>

#include "platform/RuntimeError.h"
#include "platform/sqlite/KeySet.h"

/// A place among the keys of a dynaset: on a row, before the first, behind the last, or in the gap that a
/// deleted row leaves. It begins on the first row.
class KeyCursor {
 public:
  KeyCursor() = default;
  explicit KeyCursor(KeySet keys) : keys_(std::move(keys)) { MoveFirst(); }

  const KeySet& Keys() const { return keys_; }
  bool Eof() const { return place_ == Place::End || place_ == Place::BothEnds; }
  bool Bof() const { return place_ == Place::Beginning || place_ == Place::BothEnds; }
  bool OnRow() const { return place_ == Place::Row; }
  /// Of the row, from 0; for a gap of the row behind it.
  std::size_t Position() const { return position_; }
  /// Throws RuntimeError 3021 where there is no row.
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
  /// These throw RuntimeError 3021 where they cannot go on.
  void MoveNext();
  void MovePrevious();

  /// Adds the key of a new row behind the last one; the place stays.
  void Append(std::int64_t key);
  /// Takes out the key of the row, and leaves a gap.
  void Erase();

 private:
  enum class Place { Row, Gap, Beginning, End, BothEnds };

  KeySet keys_;
  Place place_ = Place::BothEnds;
  std::size_t position_ = 0;
};
