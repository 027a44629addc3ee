#pragma once

#include <cstddef>
#include <cstdint>
#include <optional>
#include <span>
#include <string>

namespace sim {

/// The two kinds of sound hardware. A gun's own firmware stores pages and a table of where each sound starts;
/// a separate recorder stores sound by sound. The speed of the line tells which of them a host speaks to.
enum class RecorderMode { InProduct, StandAlone };

constexpr int InProductBaud = 19200;
constexpr int StandAloneBaud = 115200;

constexpr RecorderMode ModeAt(int baud) {
  return baud == StandAloneBaud ? RecorderMode::StandAlone : RecorderMode::InProduct;
}

/// Page: page data or, as the first page after an erase, the table; only in a gun. Header: only stand alone,
/// where StartOrErase stands for the two commands that have the same bytes.
enum class RecorderCommandKind { Start, Erase, StartOrErase, Page, Header, End, Play };

struct RecorderCommand {
  RecorderCommandKind Kind = RecorderCommandKind::Start;
  std::uint16_t Number = 0;  ///< of a Page 0 to 65535; of the sound in a Header or Play 0 to 255

  bool operator==(const RecorderCommand&) const = default;
};

/// The command that `bytes` are as a whole; none if they are not exactly one.
std::optional<RecorderCommand> ReadRecorderCommand(RecorderMode mode, std::span<const std::uint8_t> bytes);

/// True if `bytes` are the beginning of a command, or all of it.
bool BeginsRecorderCommand(RecorderMode mode, std::span<const std::uint8_t> bytes);

/// How many of the last bytes of a broken-off block are a command with which a host begins anew (start or
/// play); 0 if none.
std::size_t NewBeginningAtEndOf(RecorderMode mode, std::span<const std::uint8_t> block);

/// For the log: "page 12".
std::string Describe(const RecorderCommand& command);

}  // namespace sim
