#pragma once

#include <cstddef>
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
///     'F' text, rows, rows (8 bytes each)        the end, since this table cannot be read: how many of its
///                                                rows can be, and how many it counts. Without a name it is
///                                                the list of tables; a table that is missing counts none.
///
/// A value is one of: 'N' (NULL), 'I' and an integer (8 bytes), 'D' and a double (8 bytes), 'S' or 'B' with a
/// length (4 bytes) and that many bytes: UTF-8 text or binary. Where "text" stands above, it is an 'S' value.
/// A 'U' before a value of a row says that the old file's own value could not be read whole.
class JetStream {
 public:
  struct Listener {
    std::function<void(const std::string& table, std::int64_t rows)> OtherTable;
    std::function<void(const std::vector<std::string>& columns)> Table;
    /// `unread` are the columns, counted from 0, whose values are not the old file's whole ones.
    std::function<void(const std::vector<Value>& row, const std::vector<std::size_t>& unread)> Row;
    std::function<void(const std::string& table, std::int64_t read, std::int64_t counted)> Unreadable;
  };

  explicit JetStream(Listener listener) : listener_(std::move(listener)) {}

  /// Throws OldDatabaseRefused for malformed input, and whatever the listener throws.
  void Take(std::string_view bytes);

  /// True once 'E' or 'F' was read.
  bool Ended() const { return ended_; }

 private:
  bool TakeItem();
  bool TakeOtherTable(std::size_t at);
  bool TakeTable(std::size_t at);
  bool TakeRow(std::size_t at);
  bool TakeFailure(std::size_t at);
  bool TakeNumber(std::size_t& at, std::size_t size, std::uint64_t& number) const;
  bool TakeValue(std::size_t& at, Value& value) const;
  bool TakeText(std::size_t& at, std::string& text) const;

  Listener listener_;
  std::string waiting_;     ///< received bytes, up to an item that is still incomplete
  std::size_t taken_ = 0;   ///< how many of these belong to items already processed
  std::vector<Value> row_;  ///< a member so that texts can be put into the memory of the last row's
  std::vector<std::size_t> unread_;
  bool inTable_ = false;
  bool ended_ = false;
};
