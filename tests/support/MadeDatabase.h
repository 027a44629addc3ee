#pragma once

#include <map>
#include <string>
#include <utility>

#include "tests/support/TemporaryFolder.h"
#include "tests/support/TestDatabase.h"

/// The bytes of the database that a script of the program ("members", "scenarios") and `more` make. Each is
/// made once in a process: tests under faults need thousands.
inline const std::string& MadeDatabase(const std::string& script, const std::string& more = "") {
  static std::map<std::pair<std::string, std::string>, std::string> made;
  std::string& bytes = made[{script, more}];
  if (bytes.empty()) {
    const TemporaryFolder folder;
    const std::string sql = ReadFile(std::string(TESSARINE_RESOURCES) + "/" + script + "_default.sql");
    OtherConnection(folder / "new.mdb").Execute(sql + ";" + more);
    bytes = ReadFile(folder / "new.mdb");
  }
  return bytes;
}
