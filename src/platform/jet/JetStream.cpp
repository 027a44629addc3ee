#include "platform/jet/JetStream.h"

#include <cstring>
#include <utility>

#include "platform/OldDatabases.h"

namespace {

constexpr std::uint64_t MostColumns = 1024;
constexpr std::uint64_t MostBytesOfValue = std::uint64_t{1} << 30U;

[[noreturn]] void FailForm() {
  throw OldDatabaseRefused();
}

/// Puts bytes into a text (tag 'S') or a blob, using the memory of the one that stands there.
void PutBytes(char tag, std::string_view bytes, Value& value) {
  if (tag == 'B') {
    value.emplace<Blob>(bytes.begin(), bytes.end());
  } else if (auto* text = std::get_if<std::string>(&value)) {
    text->assign(bytes);
  } else {
    value.emplace<std::string>(bytes);
  }
}

}  // namespace

void JetStream::Take(std::string_view bytes) {
  waiting_ += bytes;
  while (taken_ < waiting_.size()) {
    if (ended_) {
      FailForm();
    }
    if (!TakeItem()) {
      break;
    }
  }
  waiting_.erase(0, taken_);
  taken_ = 0;
}

bool JetStream::TakeItem() {
  const char tag = waiting_[taken_];
  if (tag == 'R' && inTable_) {
    return TakeRow(taken_ + 1);
  }
  if (tag == 'E' && inTable_) {
    ++taken_;
    ended_ = true;
    return true;
  }
  if (tag == 'F') {
    return TakeFailure(taken_ + 1);
  }
  if (tag == 'O' && !inTable_) {
    return TakeOtherTable(taken_ + 1);
  }
  if (tag == 'T' && !inTable_) {
    return TakeTable(taken_ + 1);
  }
  FailForm();
}

bool JetStream::TakeOtherTable(std::size_t at) {
  std::string name;
  std::uint64_t rows = 0;
  if (!TakeText(at, name) || !TakeNumber(at, 8, rows)) {
    return false;
  }
  taken_ = at;
  listener_.OtherTable(name, static_cast<std::int64_t>(rows));
  return true;
}

bool JetStream::TakeTable(std::size_t at) {
  std::string name;
  std::uint64_t count = 0;
  if (!TakeText(at, name) || !TakeNumber(at, 4, count)) {
    return false;
  }
  if (count > MostColumns) {
    FailForm();
  }
  std::vector<std::string> columns(count);
  for (std::string& column : columns) {
    if (!TakeText(at, column)) {
      return false;
    }
  }
  taken_ = at;
  inTable_ = true;
  row_.resize(columns.size());
  listener_.Table(columns);
  return true;
}

bool JetStream::TakeRow(std::size_t at) {
  unread_.clear();
  for (std::size_t i = 0; i < row_.size(); ++i) {
    if (at < waiting_.size() && waiting_[at] == 'U') {
      unread_.push_back(i);
      ++at;
    }
    if (!TakeValue(at, row_[i])) {
      return false;
    }
  }
  taken_ = at;
  listener_.Row(row_, unread_);
  return true;
}

bool JetStream::TakeFailure(std::size_t at) {
  std::string table;
  std::uint64_t read = 0;
  std::uint64_t counted = 0;
  if (!TakeText(at, table) || !TakeNumber(at, 8, read) || !TakeNumber(at, 8, counted)) {
    return false;
  }
  taken_ = at;
  ended_ = true;
  listener_.Unreadable(table, static_cast<std::int64_t>(read), static_cast<std::int64_t>(counted));
  return true;
}

bool JetStream::TakeNumber(std::size_t& at, std::size_t size, std::uint64_t& number) const {
  if (waiting_.size() - at < size) {
    return false;
  }
  number = 0;
  for (std::size_t i = size; i > 0; --i) {
    number = number << 8U | static_cast<unsigned char>(waiting_[at + i - 1]);
  }
  at += size;
  return true;
}

bool JetStream::TakeValue(std::size_t& at, Value& value) const {
  if (at >= waiting_.size()) {
    return false;
  }
  const char tag = waiting_[at++];
  std::uint64_t number = 0;
  switch (tag) {
    case 'N':
      value = std::monostate();
      return true;
    case 'I':
    case 'D':
      if (!TakeNumber(at, 8, number)) {
        return false;
      }
      if (tag == 'I') {
        value = static_cast<std::int64_t>(number);
      } else {
        double real = 0;
        std::memcpy(&real, &number, sizeof real);
        value = real;
      }
      return true;
    case 'S':
    case 'B':
      if (!TakeNumber(at, 4, number)) {
        return false;
      }
      if (number > MostBytesOfValue) {
        FailForm();
      }
      if (waiting_.size() - at < number) {
        return false;
      }
      PutBytes(tag, {waiting_.data() + at, number}, value);
      at += number;
      return true;
    default:
      FailForm();
  }
}

bool JetStream::TakeText(std::size_t& at, std::string& text) const {
  Value value;
  if (!TakeValue(at, value)) {
    return false;
  }
  auto* held = std::get_if<std::string>(&value);
  if (held == nullptr) {
    FailForm();
  }
  text = std::move(*held);
  return true;
}
