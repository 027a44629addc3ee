#include "app/StartWords.h"

StartWords ReadStartWords(const std::vector<std::string>& words) {
  StartWords read;
  bool optionsEnded = false;
  for (const std::string& word : words) {
    const bool isOption = !optionsEnded && !word.empty() && word.front() == '-';
    if (isOption && word == "--") {
      optionsEnded = true;
    } else if (word.empty() || (isOption && word != "--version" && word != "--help") ||
               (!isOption && !read.File.empty())) {
      return {.Asked = StartWords::Kind::Unknown, .Word = word};
    } else if (!isOption) {
      read.File = word;
    } else if (read.Asked == StartWords::Kind::Run) {
      read.Asked = word == "--help" ? StartWords::Kind::Help : StartWords::Kind::Version;
    }
  }
  if (read.Asked != StartWords::Kind::Run && !read.File.empty()) {
    return {.Asked = StartWords::Kind::Unknown, .Word = read.File};
  }
  return read;
}
