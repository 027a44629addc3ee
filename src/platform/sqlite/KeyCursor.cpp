#include "platform/sqlite/KeyCursor.h"

void KeyCursor::MoveFirst() {
  if (keys_.Size() == 0) {
    MoveBehind();
  } else {
    MoveTo(0);
  }
}

void KeyCursor::MoveLast() {
  if (keys_.Size() == 0) {
    MoveBehind();
  } else {
    MoveTo(keys_.Size() - 1);
  }
}

void KeyCursor::MoveBehind() {
  place_ = keys_.Size() == 0 ? Place::BothEnds : Place::End;
}

void KeyCursor::MoveNext() {
  if (Eof()) {
    throw RuntimeError(Fault::NoCurrentRecord);
  }
  const std::size_t next = place_ == Place::Gap ? position_ : place_ == Place::Beginning ? 0 : position_ + 1;
  if (next < keys_.Size()) {
    MoveTo(next);
  } else {
    MoveBehind();
  }
}

void KeyCursor::MovePrevious() {
  if (Bof()) {
    throw RuntimeError(Fault::NoCurrentRecord);
  }
  const std::size_t behind = place_ == Place::End ? keys_.Size() : position_;
  if (behind > 0) {
    MoveTo(behind - 1);
  } else {
    place_ = keys_.Size() == 0 ? Place::BothEnds : Place::Beginning;
  }
}

// If the key is already in the set, its former row was deleted by someone else and SQLite reused the key.
void KeyCursor::Append(std::int64_t key) {
  if (const std::optional<std::size_t> stale = keys_.PositionOf(key)) {
    keys_.Erase(*stale);
    if (place_ == Place::Row && position_ == *stale) {
      place_ = Place::Gap;
    } else if (position_ > *stale) {
      --position_;
    }
  }
  keys_.Append(key);
}

void KeyCursor::Erase() {
  keys_.Erase(position_);
  place_ = Place::Gap;
}
