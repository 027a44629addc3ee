#pragma once

#include <cstdint>
#include <string>
#include <string_view>

/// Writes the format that JetStream.h describes to standard output.
class ReaderOutput {
 public:
  void Tag(char tag) { Room() += tag; }
  void Number(std::uint64_t number, std::size_t bytes);
  void Null() { Tag('N'); }
  void Integer(std::int64_t value);
  void Real(double value);
  void Text(std::string_view text) { Bytes('S', text); }
  void Binary(std::string_view bytes) { Bytes('B', bytes); }

  /// Ends the program if nobody listens any more.
  void Flush();

 private:
  std::string& Room();
  void Bytes(char tag, std::string_view bytes);

  std::string waiting_;
};
