#pragma once

#include <string>

#include "platform/Files.h"

/// Where the boot loader's ini file, the memory images and the log of a comparison are: in the user's data
/// folder. What is not there is read from the program's folder.
struct BootFolder {
  std::string UserData;
  std::string Program;

  std::string ForWriting(const std::string& name) const { return UserData + "/" + name; }

  std::string ForReading(const Files& files, const std::string& name) const {
    std::string path = ForWriting(name);
    return files.FileExists(path) ? path : Program + "/" + name;
  }
};
