#pragma once

#include <string>

#include "platform/Folders.h"

class FakeFolders : public Folders {
 public:
  /// Result of LocalAppData; unless it is Found, the path is left unchanged.
  std::uint32_t Code = Found;
  std::string LocalAppDataPath = "/home/operator/.local/share";
  std::string ProgramPath = "/opt/tessarine/share/tessarine";

  std::uint32_t LocalAppData(std::string& path) const override {
    if (Code == Found) {
      path = LocalAppDataPath;
    }
    return Code;
  }

  std::string Program() const override { return ProgramPath; }
};
