#pragma once

#include <functional>
#include <string>
#include <utility>
#include <vector>

#include "core/data/SettingsTable.h"
#include "platform/Files.h"

/// Settings in an ini file, read and written key by key when used. Section and key names ignore case, the
/// first one with a given name counts, and only ";" begins a comment. Texts are UTF-8; a value that is not
/// valid UTF-8 is read as code page 1252.
///
/// Our own, because no library's reader keeps these rules: the first of two keys counts, a value ends after
/// 254 bytes, names and values are decoded one by one, and a write leaves every other line as it is, byte for
/// byte, with its comments, blanks and line breaks.
class IniReader {
 public:
  using Values = std::vector<std::pair<std::string, std::string>>;

  /// Called after each attempt to write, with whether the file now holds the values.
  std::function<void(bool written)> AfterWrite;

  /// `files` must outlive the reader. The file at `path` need not exist.
  IniReader(Files& files, std::string path);

  /// The value without surrounding blanks and without one pair of quotes around it, at most 254 bytes;
  /// `defaultText` unchanged if the file, the section or the key is missing. No content of the file makes it
  /// throw.
  std::string ReadIni(const std::string& section, const std::string& key,
                      const std::string& defaultText) const;

  /// The value of a setting, or its default.
  std::string ReadIni(const Setting& setting) const {
    return ReadIni(setting.Section, setting.Key, setting.Default);
  }

  /// Keys and values of all sections with this name, in file order, each value as ReadIni returns it.
  Values ReadSection(const std::string& section) const;

  /// Changes or adds one value; every other line is left as it is. If the file cannot be read or written, or
  /// `value` contains a line break, the file is left unchanged and nobody is told but AfterWrite.
  void WriteIni(const std::string& section, const std::string& key, const std::string& value);

  void WriteIni(const Setting& setting, const std::string& value) {
    WriteIni(setting.Section, setting.Key, value);
  }

  /// The same for several values, all or none of them. Returns false if the file is unchanged.
  bool WriteIni(const std::string& section, const Values& values);

 private:
  Files& files_;
  bool TryWrite(const std::string& section, const Values& values);

  std::string path_;
};
