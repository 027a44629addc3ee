#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <string>
#include <vector>

#include "core/text/TextEncoding.h"
#include "exports/Csv.h"

namespace {

void Require(bool condition) {
  if (!condition) {
    std::abort();
  }
}

struct ReadText {
  std::string Text;
  bool IsNull;
  bool operator==(const ReadText&) const = default;
};

using ReadRows = std::vector<std::vector<ReadText>>;

constexpr CsvLimits Limits{.CellBytes = 2000, .RowBytes = 8000, .Cells = 50};

/// All rows up to the end or a fault. Lines rise, and limits hold.
ReadRows RowsOf(CsvReader& reader, bool limited) {
  ReadRows rows;
  std::size_t line = 0;
  while (reader.Next()) {
    Require(reader.Line() > line && !reader.Fault() && reader.Position() <= reader.Size());
    line = reader.Line();
    std::vector<ReadText>& row = rows.emplace_back();
    for (const CsvCell& cell : reader.Row()) {
      Require(IsUtf8(cell.Text));
      Require(!limited || cell.Text.size() <= Limits.CellBytes);
      row.push_back({std::string(cell.Text), cell.IsNull()});
    }
    Require(!row.empty() && (!limited || row.size() <= Limits.Cells));
  }
  Require(reader.Fault() ? reader.Line() >= line : reader.Position() == reader.Size());
  Require(!reader.Next());
  return rows;
}

}  // namespace

/// What is read is written so that it reads the same.
extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  const std::string bytes(data, data + size);
  CsvReader reader(bytes, Limits);
  const ReadRows rows = RowsOf(reader, true);
  for (const bool mark : {false, true}) {
    CsvWriter writer(reader.Separator(), mark);
    for (const std::vector<ReadText>& row : rows) {
      for (const ReadText& cell : row) {
        if (cell.IsNull) {
          writer.Empty();
        } else {
          writer.Text(cell.Text);
        }
      }
      writer.EndRow();
    }
    const std::string written = writer.Take();
    CsvReader again(written, reader.Separator());
    Require(RowsOf(again, false) == rows && !again.Fault());
  }
  return 0;
}
