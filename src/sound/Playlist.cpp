#include "sound/Playlist.h"

#include "core/text/TextEncoding.h"

std::string WritePlaylist(const std::vector<std::string>& paths) {
  std::string bytes;
  for (const std::string& path : paths) {
    bytes.append("\"").append(path).append("\"\r\n");
  }
  return bytes;
}

std::vector<std::string> ReadPlaylist(std::string_view bytes) {
  constexpr std::string_view mark = "\xEF\xBB\xBF";
  if (bytes.starts_with(mark)) {
    bytes.remove_prefix(mark.size());
  }
  const std::string text = IsUtf8(bytes) ? std::string(bytes) : Windows1252ToUtf8(bytes);
  std::vector<std::string> records;
  std::string_view rest = text;
  while (!rest.empty()) {
    const std::size_t end = rest.find('\n');
    std::string_view line = rest.substr(0, end);
    rest.remove_prefix(end == std::string_view::npos ? rest.size() : end + 1);
    if (line.ends_with('\r')) {
      line.remove_suffix(1);
    }
    if (line.size() >= 2 && line.front() == '"' && line.back() == '"') {
      line = line.substr(1, line.size() - 2);
    }
    records.emplace_back(line);
  }
  return records;
}

bool FitsPlaylist(std::string_view path) {
  return path.find_first_of("\"\r\n") == std::string_view::npos;
}
