#include "core/data/IniReader.h"

#include <algorithm>
#include <optional>
#include <string_view>

#include "core/text/Pieces.h"
#include "core/text/TextEncoding.h"
#include "platform/Letters.h"
#include "platform/RuntimeError.h"

namespace {

/// The 255-byte buffer that callers have always passed, less its terminator.
constexpr std::size_t MostBytesOfValue = 254;

constexpr std::string_view ByteOrderMark = "\xEF\xBB\xBF";

/// Names and values are decoded one by one, since in an old file the values written by this program are UTF-8
/// among others in code page 1252.
std::string Decoded(std::string_view bytes) {
  return IsUtf8(bytes) ? std::string(bytes) : Windows1252ToUtf8(bytes);
}

bool SameName(std::string_view bytes, std::string_view name) {
  const std::string decoded = Decoded(bytes);
  return std::equal(decoded.begin(), decoded.end(), name.begin(), name.end(),
                    [](char left, char right) { return LowerAscii(left) == LowerAscii(right); });
}

std::string ShownValue(std::string_view bytes) {
  std::string_view content = Trimmed(bytes, IsBlank);
  if (content.size() >= 2 && content.front() == content.back() &&
      (content.front() == '"' || content.front() == '\'')) {
    content = content.substr(1, content.size() - 2);
  }
  std::string value = Decoded(content);
  value.resize(FirstBytes(value, MostBytesOfValue).size());
  return value;
}

/// Iterates over the lines of an ini file. Offsets are into the file's bytes.
class Lines {
 public:
  enum class Kind { Other, Section, Entry };

  Kind LineKind = Kind::Other;
  std::string_view Name;       ///< of the section or key
  std::string_view Value;      ///< of an entry: everything after the "="
  std::size_t ValueStart = 0;  ///< of an entry
  std::size_t End = 0;         ///< where the line ends, without its line break
  std::size_t Next = 0;        ///< where the next line begins

  explicit Lines(std::string_view bytes)
      : Next(bytes.starts_with(ByteOrderMark) ? ByteOrderMark.size() : 0), bytes_(bytes) {}

  bool Advance() {
    if (Next >= bytes_.size()) {
      return false;
    }
    const std::size_t start = Next;
    End = std::min(bytes_.find_first_of("\r\n", start), bytes_.size());
    Next = std::min(End + (bytes_.substr(End, 2) == "\r\n" ? 2 : 1), bytes_.size());
    const std::string_view line = Trimmed(bytes_.substr(start, End - start), IsBlank);
    LineKind = Kind::Other;
    if (line.starts_with('[')) {
      if (const std::size_t close = line.find(']'); close != std::string_view::npos) {
        LineKind = Kind::Section;
        Name = Trimmed(line.substr(1, close - 1), IsBlank);
      }
    } else if (const std::size_t equals = line.find('=');
               equals != std::string_view::npos && !line.starts_with(';')) {
      LineKind = Kind::Entry;
      Name = Trimmed(line.substr(0, equals), IsBlank);
      ValueStart = bytes_.find('=', start) + 1;
      Value = bytes_.substr(ValueStart, End - ValueStart);
    }
    return true;
  }

 private:
  std::string_view bytes_;
};

std::string_view LineBreakOf(std::string_view bytes) {
  const std::size_t first = bytes.find_first_of("\r\n");
  return first != std::string_view::npos && bytes.substr(first, 2) == "\r\n" ? "\r\n" : "\n";
}

/// `bytes` with the value of one key changed in place, or the key added after the last one of its section.
std::string WithValue(std::string bytes, std::string_view section, std::string_view key,
                      std::string_view value) {
  std::optional<std::size_t> insertAt;
  bool inSection = false;
  bool inFirstPart = false;
  for (Lines lines(bytes); lines.Advance();) {
    if (lines.LineKind == Lines::Kind::Section) {
      inSection = SameName(lines.Name, section);
      inFirstPart = inSection && !insertAt;
    } else if (inSection && lines.LineKind == Lines::Kind::Entry && SameName(lines.Name, key)) {
      return bytes.replace(lines.ValueStart, lines.End - lines.ValueStart, value);
    }
    if (inFirstPart && lines.LineKind != Lines::Kind::Other) {
      insertAt = lines.Next;
    }
  }
  const std::string lineBreak(LineBreakOf(bytes));
  std::string added;
  const std::size_t at = insertAt.value_or(bytes.size());
  if (at > 0 && bytes != ByteOrderMark && bytes[at - 1] != '\n' && bytes[at - 1] != '\r') {
    added += lineBreak;
  }
  if (!insertAt) {
    added.append("[").append(section).append("]").append(lineBreak);
  }
  added.append(key).append("=").append(value).append(lineBreak);
  return bytes.insert(at, added);
}

}  // namespace

IniReader::IniReader(Files& files, std::string path) : files_(files), path_(std::move(path)) {}

std::string IniReader::ReadIni(const std::string& section, const std::string& key,
                               const std::string& defaultText) const {
  for (const auto& [name, value] : ReadSection(section)) {
    if (SameName(name, key)) {
      return value;
    }
  }
  return defaultText;
}

IniReader::Values IniReader::ReadSection(const std::string& section) const {
  std::string bytes;
  try {
    bytes = files_.Read(path_);
  } catch (const RuntimeError&) {
    return {};
  }
  Values values;
  bool inSection = false;
  for (Lines lines(bytes); lines.Advance();) {
    if (lines.LineKind == Lines::Kind::Section) {
      inSection = SameName(lines.Name, section);
    } else if (inSection && lines.LineKind == Lines::Kind::Entry) {
      values.emplace_back(Decoded(lines.Name), ShownValue(lines.Value));
    }
  }
  return values;
}

void IniReader::WriteIni(const std::string& section, const std::string& key, const std::string& value) {
  WriteIni(section, {{key, value}});
}

bool IniReader::WriteIni(const std::string& section, const Values& values) {
  const bool written = TryWrite(section, values);
  if (AfterWrite) {
    AfterWrite(written);
  }
  return written;
}

bool IniReader::TryWrite(const std::string& section, const Values& values) {
  const bool broken = std::any_of(values.begin(), values.end(), [](const auto& entry) {
    return entry.second.find_first_of("\r\n") != std::string::npos;
  });
  if (broken) {
    return false;
  }
  try {
    std::string bytes = files_.FileExists(path_) ? files_.Read(path_) : std::string();
    for (const auto& [key, value] : values) {
      bytes = WithValue(std::move(bytes), section, key, value);
    }
    files_.Replace(path_, bytes);
    return true;
  } catch (const RuntimeError&) {
    // Callers carry on with the value in memory; the file is unchanged.
    return false;
  }
}
