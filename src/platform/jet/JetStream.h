#pragma once

#include <cstdint>
#include <functional>
#include <string>
#include <string_view>
#include <vector>

#include "platform/Database.h"

/// Parses the output of tessarine-jet-reader, in pieces of any size. Numbers are little-endian.
///
///     'O' text, rows (8 bytes)                   another table than the one requested; any number of these
///     'T' text, columns (4 bytes), that many texts   the requested table
///     'R' a value for each column                a row; any number of these
///     'E'                                        the end
///
/// A value is one of: 'N' (NULL), 'I' and an integer (8 bytes), 'D' and a double (8 bytes), 'S' or 'B' with a
/// length (4 bytes) and that many bytes: UTF-8 text or binary. Where "text" stands above, it is an 'S' value.
class JetStream {
 public:
  struct Listener {
    std::function<void(const std::string& table, std::int64_t rows)> OtherTable;
    std::function<void(const std::vector<std::string>& columns)> Table;
    std::function<void(const std::vector<Value>& row)> Row;
  };

  explicit JetStream(Listener listener) : listener_(std::move(listener)) {}

  /// Throws RuntimeError 3343 for malformed input, and whatever the listener throws.
  void Take(std::string_view bytes);

  /// True once 'E' was read.
  bool Ended() const { return ended_; }

 private:
  bool TakeItem();
  bool TakeOtherTable(std::size_t at);
  bool TakeTable(std::size_t at);
  bool TakeRow(std::size_t at);
  bool TakeNumber(std::size_t& at, std::size_t size, std::uint64_t& number) const;
  bool TakeValue(std::size_t& at, Value& value) const;
  bool TakeText(std::size_t& at, std::string& text) const;

  Listener listener_;
  std::string waiting_;    ///< received bytes, up to an item that is still incomplete
  std::size_t taken_ = 0;  ///< how many of these belong to items already processed
  std::size_t columns_ = 0;
  bool inTable_ = false;
  bool ended_ = false;
};
