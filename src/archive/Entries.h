#pragma once

#include <cstddef>
#include <cstdint>
#include <memory>
#include <string>
#include <string_view>

#include "platform/Database.h"

/// The entries of the archive, each a game file, as the sqlite3 tool reads and writes them.

/// Largest game file that is unpacked, in bytes. The fullest game that a gun can bring about has 10 MB.
inline constexpr std::size_t LargestEntry = std::size_t{32} << 20U;

/// "2026-11-21/2015-000123.game.xml" for a game of the local time `played` ("YYYY-MM-DD HH:MM:SS"); with a
/// `state` above 0 "2026-11-21/2015-000123-1.game.xml". A time of another form becomes "undated/000123".
std::string EntryName(std::string_view played, std::int64_t gameId, std::int64_t state);

/// Seconds since 1970 of a local time ("YYYY-MM-DD HH:MM:SS"); 0 for a text of another form.
std::int64_t SecondsOf(const std::string& localTime);

/// Deflates bytes that come piece by piece.
class Packer {
 public:
  Packer();
  ~Packer();
  Packer(const Packer&) = delete;
  Packer& operator=(const Packer&) = delete;

  void Add(std::string_view bytes);
  /// All of them, deflated; once, and nothing may be added afterwards.
  Blob Finish();

  /// How many bytes were added.
  std::size_t Size() const { return size_; }

 private:
  class Stream;

  std::unique_ptr<Stream> stream_;
  std::size_t size_ = 0;
};

/// `bytes` as an entry holds them: deflated, or as they are where that is not shorter.
Blob Packed(std::string_view bytes);

enum class Unpacking {
  Done,
  Damaged,   ///< not what was packed
  TooLarge,  ///< more than LargestEntry
};

/// The bytes of an entry that holds `data` and says that they are `size` bytes. `bytes` are empty unless
/// Done. Takes no more memory than LargestEntry and some, whatever the entry holds or says.
Unpacking Unpack(const Blob& data, std::int64_t size, std::string& bytes);

/// The first bytes of an entry, `most` at most; fewer if it is shorter, or damaged there. Of its data,
/// deflated or not, no more need be in `start` than the first bytes.
std::string BeginningOf(const Blob& start, bool isDeflated, std::size_t most);

/// Compares an entry with bytes that come piece by piece, without holding either as a whole.
class EntryComparison {
 public:
  /// `data` and `size` as in Unpack; `data` must outlive this object.
  EntryComparison(const Blob& data, std::int64_t size);
  ~EntryComparison();
  EntryComparison(const EntryComparison&) = delete;
  EntryComparison& operator=(const EntryComparison&) = delete;

  void Add(std::string_view bytes);
  /// True if the entry holds what was added, and nothing else.
  bool IsEqual();

 private:
  class Stream;

  std::unique_ptr<Stream> stream_;
  const std::int64_t size_;
  std::int64_t added_ = 0;
  bool isEqual_ = true;
};
