#pragma once

#include <regex>
#include <sstream>
#include <string>
#include <vector>

#include "tests/support/TemporaryFolder.h"

/// A heading of the manual and what stands below it, up to the next heading.
struct ManualPart {
  int Level = 0;
  std::string Title;
  int TableRows = 0;
  int ListItems = 0;
  int CodeLines = 0;
  int Paragraphs = 0;
  int Pictures = 0;
};

/// One edition of the manual, as it stands in the file.
class Edition {
 public:
  explicit Edition(const std::string& name) : text_(ReadFile(std::string(TESSARINE_DOCS "/") + name)) {}

  const std::string& Text() const { return text_; }

  std::vector<ManualPart> Parts() const {
    std::vector<ManualPart> parts;
    bool inCode = false;
    bool inParagraph = false;
    for (const std::string& line : Lines()) {
      if (line.starts_with("```")) {
        inCode = !inCode;
      } else if (inCode) {
        ++parts.back().CodeLines;
      } else if (const auto level = line.find_first_not_of('#'); level != 0 && line.starts_with('#')) {
        parts.push_back({.Level = static_cast<int>(level), .Title = line.substr(level + 1)});
      } else if (!parts.empty()) {
        Count(line, inParagraph, parts.back());
      }
      inParagraph = !inCode && !line.empty() && line.front() != '#';
    }
    return parts;
  }

  /// The anchors of the links inside the manual, or of those in its table of contents alone.
  std::vector<std::string> Links(bool ofContents = false) const {
    return Found(R"(\]\((#[^)]+)\))", ofContents ? text_.substr(0, text_.find("\n## ")) : text_);
  }

  /// The pictures, by their file names below the manual's folder.
  std::vector<std::string> Pictures() const { return Found(R"(!\[[^\]]+\]\(([^)]+)\))", text_); }

  /// Section, key and default of each setting.
  std::vector<std::string> Settings() const { return Found(R"(\n(\| `\[[^|]*\|[^|]*\|[^|]*\|))", text_); }

 private:
  std::vector<std::string> Lines() const {
    std::vector<std::string> lines;
    std::istringstream text(text_);
    for (std::string line; std::getline(text, line);) {
      lines.push_back(line);
    }
    return lines;
  }

  static void Count(const std::string& line, bool inParagraph, ManualPart& part) {
    static const std::regex item(R"((\*|\d+\.) .*)");
    if (line.starts_with('|')) {
      ++part.TableRows;
    } else if (line.starts_with("![")) {
      ++part.Pictures;
    } else if (std::regex_match(line, item)) {
      ++part.ListItems;
    } else if (!line.empty() && !inParagraph) {
      ++part.Paragraphs;
    }
  }

  static std::vector<std::string> Found(const char* pattern, const std::string& text) {
    const std::regex regex(pattern);
    std::vector<std::string> found;
    for (std::sregex_iterator match(text.begin(), text.end(), regex), end; match != end; ++match) {
      found.push_back((*match)[1]);
    }
    return found;
  }

  const std::string text_;
};
