#pragma once

#include <memory>
#include <string>
#include <utility>
#include <vector>

/// Fills documents the way a script would, with one call per bookmark and per cell.
class PlainSheets {
 public:
  /// Connects to the LibreOffice that listens on `pipe`, waiting until it does.
  explicit PlainSheets(const std::string& pipe);
  ~PlainSheets();

  struct Sheet {
    std::vector<std::pair<const char*, std::string>> Bookmarks;
    std::string Photo;  ///< its path
    std::vector<std::string> Scored;
    std::vector<std::string> Taken;
    std::string Target;
  };
  void Make(const std::string& templatePath, const Sheet& sheet);

  void Quit();

 private:
  struct Office;
  std::unique_ptr<Office> office_;
};
