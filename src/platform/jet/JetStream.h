#pragma once

#include <cstdint>
#include <functional>
#include <string>
#include <string_view>
#include <vector>

#include "platform/Database.h"

/// Takes in what the reader of Jet files writes, in pieces of any size. Numbers have their low byte first.
///
///     'O' text, rows (8 bytes)                   a table that was not asked for; any number of these
///     'T' text, columns (4 bytes), that many texts   the table that was
///     'R' a value for each column                a row; any number of these
///     'E'                                        the end
///
/// A value, and a text among them, is one of: 'N' (NULL), 'I' and 8 bytes, 'D' and the 8 bytes of a double,
/// 'S' and 'B' with a length (4 bytes) and that many bytes: a text in UTF-8, or bytes.
class JetStream {
 public:
  struct Listener {
    std::function<void(const std::string& table, std::int64_t rows)> OtherTable;
    std::function<void(const std::vector<std::string>& columns)> Table;
    std::function<void(const std::vector<Value>& row)> Row;
  };

  explicit JetStream(Listener listener) : listener_(std::move(listener)) {}

  /// Throws RuntimeError 3343 for what is not of this form, and what the listener throws.
  void Take(std::string_view bytes);

  /// True once the end has come.
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
  std::string waiting_;    ///< bytes of items that are not complete yet
  std::size_t taken_ = 0;  ///< of them that belong to items that are done
  std::size_t columns_ = 0;
  bool inTable_ = false;
  bool ended_ = false;
};
