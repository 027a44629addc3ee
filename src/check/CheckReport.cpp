#include "check/CheckReport.h"

#include <string_view>

#include "core/text/Pieces.h"

namespace {

/// Puts "~" for `name` wherever that is the end of a path or of a folder's name in one.
void PutTilde(std::string& text, const std::string& name, const std::string& tilde) {
  constexpr std::string_view ends = "/ '\"):,;\n";
  for (std::size_t at = text.find(name); at != std::string::npos;) {
    const std::size_t end = at + name.size();
    if (end == text.size() || ends.find(text[end]) != std::string_view::npos) {
      text.replace(at, name.size(), tilde);
      at = text.find(name, at + tilde.size());
    } else {
      at = text.find(name, end);
    }
  }
}

}  // namespace

std::string NameOf(CheckSubject subject, const StringTable& strings) {
  return PartsOf(strings.Text(OwnText::CheckSubjects), '|').at(static_cast<std::size_t>(subject));
}

std::string StateOf(const CheckItem& item, const StringTable& strings) {
  return strings.Text(item.Fine ? OwnText::CheckFine : OwnText::CheckToDo);
}

std::string WithoutUser(std::string text, const std::string& homeFolder, const std::string& userName) {
  if (homeFolder.size() > 1) {
    PutTilde(text, homeFolder, "~");
  }
  if (!userName.empty()) {
    PutTilde(text, '/' + userName, "/~");
  }
  return text;
}

std::string CheckReport(const std::vector<std::string>& facts, const std::vector<CheckItem>& items,
                        const StringTable& strings) {
  std::string report;
  for (const std::string& fact : facts) {
    report.append(fact).append("\n");
  }
  report.append("\n");
  for (const CheckItem& item : items) {
    report.append(NameOf(item.Subject, strings)).append(": ");
    report.append(StateOf(item, strings)).append(": ").append(item.Text).append("\n");
  }
  return report;
}
