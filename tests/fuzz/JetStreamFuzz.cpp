#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <string_view>

#include "platform/RuntimeError.h"
#include "platform/jet/JetStream.h"

namespace {

struct Counts {
  std::size_t Columns = 0;
  std::size_t Rows = 0;
  std::size_t Values = 0;
  bool Ended = false;
  bool Refused = false;
};

Counts Take(std::string_view bytes, std::size_t piece) {
  Counts counts;
  JetStream stream(
      {.OtherTable = [](const std::string&, std::int64_t) {},
       .Table = [&](const std::vector<std::string>& columns) { counts.Columns = columns.size(); },
       .Row =
           [&](const std::vector<Value>& row) {
             ++counts.Rows;
             counts.Values += row.size();
           }});
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

}  // namespace

// No input from the reader does harm, and how it is split into pieces makes no difference.
extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  const std::string_view bytes(reinterpret_cast<const char*>(data), size);
  const Counts whole = Take(bytes, size + 1);
  const Counts pieces = Take(bytes, 3);
  if (whole.Rows != pieces.Rows || whole.Values != pieces.Values || whole.Columns != pieces.Columns ||
      whole.Ended != pieces.Ended || whole.Refused != pieces.Refused ||
      whole.Values != whole.Rows * whole.Columns) {
    std::abort();
  }
  return 0;
}
