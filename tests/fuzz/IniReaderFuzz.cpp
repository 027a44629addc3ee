#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <string>
#include <vector>

#include "core/data/IniReader.h"
#include "core/text/TextEncoding.h"
#include "tests/fakes/FakeFiles.h"

namespace {

constexpr const char* Path = "/tessarine.ini";
constexpr const char* Section = "comm";
constexpr const char* Key = "commport";

void Require(bool condition) {
  if (!condition) {
    std::abort();
  }
}

/// The non-empty lines of `bytes`, without the byte-order mark and line breaks.
std::vector<std::string> LinesOf(const std::string& bytes) {
  std::vector<std::string> lines;
  std::string line;
  for (const char letter : bytes.substr(bytes.starts_with("\xEF\xBB\xBF") ? 3 : 0) + "\n") {
    if (letter != '\r' && letter != '\n') {
      line += letter;
    } else if (!line.empty()) {
      lines.push_back(line);
      line.clear();
    }
  }
  return lines;
}

/// True if `after` is `before` with one line changed, or with one or two lines added at one place.
bool DiffersInOnePlace(const std::vector<std::string>& before, const std::vector<std::string>& after) {
  std::size_t same = 0;
  while (same < before.size() && same < after.size() && before[same] == after[same]) {
    ++same;
  }
  std::size_t sameAtEnd = 0;
  while (same + sameAtEnd < before.size() && same + sameAtEnd < after.size() &&
         before[before.size() - 1 - sameAtEnd] == after[after.size() - 1 - sameAtEnd]) {
    ++sameAtEnd;
  }
  const std::size_t gone = before.size() - same - sameAtEnd;
  const std::size_t added = after.size() - same - sameAtEnd;
  return after.size() == before.size() ? gone == added && gone <= 1 : gone == 0 && added <= 2;
}

bool ComesBackAsItIs(const std::string& value) {
  const auto isOuter = [](char letter) {
    return letter == ' ' || letter == '\t' || letter == '"' || letter == '\'';
  };
  return value.size() <= 254 && IsUtf8(value) && value.find_first_of("\r\n") == std::string::npos &&
         (value.empty() || (!isOuter(value.front()) && !isOuter(value.back())));
}

}  // namespace

/// The first byte is the length of the value to write, which follows; the rest is the file.
extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  std::string input(data, data + size);
  const std::size_t valueLength = input.empty() ? 0 : static_cast<unsigned char>(input[0]);
  const std::string value = input.substr(input.empty() ? 0 : 1, valueLength);
  const std::string bytes = input.substr(std::min(input.size(), 1 + valueLength));

  FakeFiles files;
  files.Put(Path, bytes);
  IniReader ini(files, Path);
  const std::string before = ini.ReadIni(Section, Key, "default");
  Require(before.size() <= 254 && IsUtf8(before));
  const IniReader::Values section = ini.ReadSection("other");

  ini.WriteIni(Section, Key, value);
  const std::string written = files.Read(Path);
  if (value.find_first_of("\r\n") != std::string::npos) {
    Require(written == bytes);
    return 0;
  }
  if (ComesBackAsItIs(value)) {
    Require(ini.ReadIni(Section, Key, "default") == value);
  }
  Require(ini.ReadSection("other") == section);
  Require(written.starts_with("\xEF\xBB\xBF") == bytes.starts_with("\xEF\xBB\xBF"));
  Require(DiffersInOnePlace(LinesOf(bytes), LinesOf(written)));

  ini.WriteIni(Section, Key, value);
  Require(files.Read(Path) == written);
  return 0;
}
