#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <string>
#include <string_view>

#include "platform/RuntimeError.h"
#include "platform/Utf8.h"
#include "platform/jet/JetStream.h"
#include "platform/jet/JetText.h"

namespace {

struct Counts {
  std::size_t Columns = 0;
  std::size_t Rows = 0;
  std::size_t Values = 0;
  std::size_t Unread = 0;
  std::string Failure;
  bool Ended = false;
  bool Refused = false;

  bool operator==(const Counts&) const = default;
};

Counts Take(std::string_view bytes, std::size_t piece) {
  Counts counts;
  JetStream stream(
      {.OtherTable = [](const std::string&, std::int64_t) {},
       .Table = [&](const std::vector<std::string>& columns) { counts.Columns = columns.size(); },
       .Row =
           [&](const std::vector<Value>& row, const std::vector<std::size_t>& unread) {
             ++counts.Rows;
             counts.Values += row.size();
             counts.Unread += unread.size();
           },
       .Unreadable = [&](const std::string& table, std::int64_t, std::int64_t) { counts.Failure = table; }});
  try {
    for (std::size_t at = 0; at < bytes.size(); at += piece) {
      stream.Take(bytes.substr(at, piece));
    }
  } catch (const RuntimeError&) {
    counts.Refused = true;
  }
  counts.Ended = stream.Ended();
  return counts;
}

// Texts of an old file become UTF-8, whatever their bytes are.
void CheckText(std::string_view bytes) {
  const std::string text = DecodeJetText(bytes).Utf8;
  for (std::string_view rest = text; !rest.empty();) {
    const std::size_t length = Utf8::LengthOfCharacter(rest);
    if (length == 0) {
      std::abort();
    }
    rest.remove_prefix(length);
  }
}

}  // namespace

// No input from the reader does harm, and how it is split into pieces makes no difference.
extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  const std::string_view bytes(reinterpret_cast<const char*>(data), size);
  const Counts whole = Take(bytes, size + 1);
  const Counts pieces = Take(bytes, 3);
  if (whole != pieces || whole.Values != whole.Rows * whole.Columns || whole.Unread > whole.Values) {
    std::abort();
  }
  CheckText(bytes);
  return 0;
}
