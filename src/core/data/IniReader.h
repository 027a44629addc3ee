#pragma once

#include <string>
#include <utility>
#include <vector>

#include "core/data/SettingsTable.h"
#include "platform/Files.h"

/// Settings in an ini file, read and written key by key at the moment of use. Sections and keys are found in
/// any case, the first one with a given name counts, and only ";" begins a comment. Texts are UTF-8; a value
/// that is not is taken as code page 1252.
///
/// Not a library's reader, for none keeps these rules: the first of two keys counts, a value ends after 254
/// bytes, names and values are decoded one by one, and a write leaves every other line as it is to the byte,
/// with its comments, blanks and line breaks.
class IniReader {
 public:
  using Values = std::vector<std::pair<std::string, std::string>>;

  /// `files` must outlive the reader. The file at `path` need not exist.
  IniReader(Files& files, std::string path);

  /// The value without blanks and without one pair of quotes around it, at most 254 bytes; `defaultText` as
  /// it stands when the file, the section or the key is missing. Never throws on any content of the file.
  std::string ReadIni(const std::string& section, const std::string& key,
                      const std::string& defaultText) const;

  /// The value of a setting, or its default.
  std::string ReadIni(const Setting& setting) const {
    return ReadIni(setting.Section, setting.Key, setting.Default);
  }

  /// Keys and values of all parts of a section in the order of the file, each value as ReadIni gives it.
  Values ReadSection(const std::string& section) const;

  /// Changes or adds one value; every other line stays as it is. When the file cannot be read or written, or
  /// `value` has a line break, the file stays as it was and nothing is reported.
  void WriteIni(const std::string& section, const std::string& key, const std::string& value);

  void WriteIni(const Setting& setting, const std::string& value) {
    WriteIni(setting.Section, setting.Key, value);
  }

  /// The same for several values, all or none of them.
  void WriteIni(const std::string& section, const Values& values);

 private:
  Files& files_;
  std::string path_;
};
