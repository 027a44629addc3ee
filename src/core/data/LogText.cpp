#include "core/data/LogText.h"

#include <algorithm>
#include <iterator>

#include "platform/Letters.h"

namespace {

constexpr std::size_t ButtonDigits = 16;

bool IsHexDigit(char c) {
  return IsDigit(c) || (LowerAscii(c) >= 'a' && LowerAscii(c) <= 'f');
}

bool IsLetterOrDigit(char c) {
  return IsDigit(c) || (LowerAscii(c) >= 'a' && LowerAscii(c) <= 'z');
}

/// True if a path or a quotation can begin at `at`: not in the middle of "photo's" or "Path/File".
bool BeginsAt(std::string_view line, std::size_t at) {
  return at == 0 || !IsLetterOrDigit(line[at - 1]);
}

/// The file name ("members.mdb") at the start of `rest`, the text after the data folder; empty for a file
/// that is not the program's own.
std::string_view OwnName(std::string_view rest) {
  if (!rest.starts_with('/')) {
    return {};
  }
  rest.remove_prefix(1);
  const auto end = std::find_if(rest.begin(), rest.end(), [](char c) {
    return !IsLetterOrDigit(c) && c != '.' && c != '_' && c != '-';
  });
  std::string_view name = rest.substr(0, static_cast<std::size_t>(end - rest.begin()));
  while (name.ends_with('.')) {
    name.remove_suffix(1);  // the end of the sentence
  }
  const bool isFile = end == rest.end() || *end != '/';
  static constexpr std::string_view stems[] = {"members", "scenarios", "score_card", "tessarine", "state"};
  const bool isOwn =
      isFile && std::any_of(std::begin(stems), std::end(stems), [name](std::string_view stem) {
        return name.starts_with(std::string(stem) + '.') || name.starts_with(std::string(stem) + '-');
      });
  return isOwn ? name : std::string_view();
}

/// The replacement for a path that reaches to the end of the line; names the kind of file if it is known.
std::string HiddenPath(std::string_view path) {
  while (!path.empty() && !IsLetterOrDigit(path.back())) {
    path.remove_suffix(1);
  }
  // Not just anything after a dot, which could be a name.
  static constexpr std::string_view known[] = {"bmp", "csv",  "doc", "gif",  "hex", "html",
                                               "ini", "jpeg", "jpg", "json", "log", "mdb",
                                               "pdf", "png",  "txt", "wav",  "xml"};
  const std::string_view extension = path.substr(path.rfind('.') + 1);
  const bool shows = std::find(std::begin(known), std::end(known), extension) != std::end(known);
  return shows ? "(a ." + std::string(extension) + " file)" : "(a path)";
}

bool IsNumber(std::string_view text) {
  return std::all_of(text.begin(), text.end(), IsDigit);
}

/// Length of the quotation with which `rest` begins, up to the last quote of the line, since a name may
/// contain one; 0 for a plain number, which need not be hidden, and for a quotation without an end.
std::size_t QuotedLength(std::string_view rest) {
  const std::size_t next = rest.find('\'', 1);
  if (next == std::string_view::npos || IsNumber(rest.substr(1, next - 1))) {
    return 0;
  }
  return rest.rfind('\'') + 1;
}

/// Moves `at` past the part of the line there that must not be shown and returns its replacement; otherwise
/// past one character, which it returns.
std::string TakeNext(std::string_view line, std::size_t& at, std::string_view dataFolder) {
  const std::string_view rest = line.substr(at);
  if (BeginsAt(line, at) && !dataFolder.empty() && rest.starts_with(dataFolder)) {
    const std::string_view after = rest.substr(dataFolder.size());
    if (const std::string_view name = OwnName(after); !name.empty()) {
      at += dataFolder.size() + 1 + name.size();
      return std::string(name);
    }
    if (after.empty() || after.front() == ' ' || after.front() == '.' || after.front() == ',') {
      at += dataFolder.size();
      return "(data folder)";
    }
  }
  if (rest.front() == '/' && BeginsAt(line, at)) {
    at = line.size();
    return HiddenPath(rest);
  }
  if (rest.front() == '\'' && BeginsAt(line, at)) {
    if (const std::size_t quoted = QuotedLength(rest); quoted > 0) {
      at += quoted;
      return "'...'";
    }
  }
  const auto digits =
      static_cast<std::size_t>(std::find_if_not(rest.begin(), rest.end(), IsHexDigit) - rest.begin());
  if (digits >= ButtonDigits) {
    at += digits;
    return "(number)";
  }
  ++at;
  return {rest.front()};
}

std::string LineText(std::string_view line, std::string_view dataFolder) {
  std::string text;
  for (std::size_t at = 0; at < line.size();) {
    text += TakeNext(line, at, dataFolder);
  }
  return text;
}

}  // namespace

std::string LogText(std::string_view text, std::string_view dataFolder) {
  std::string result;
  while (!text.empty()) {
    const std::size_t end = std::min(text.find_first_of("\r\n"), text.size());
    const std::string line = LineText(text.substr(0, end), dataFolder);
    if (!line.empty()) {
      result += (result.empty() ? "" : " | ") + line;
    }
    text.remove_prefix(std::min(end + 1, text.size()));
  }
  std::replace_if(
      result.begin(), result.end(), [](char c) { return static_cast<unsigned char>(c) < ' '; }, ' ');
  return result;
}
