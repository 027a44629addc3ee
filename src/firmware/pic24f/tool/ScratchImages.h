#pragma once

#include <string>

#include "firmware/hex/HexImport.h"

/// Names for images and a log in the system's temporary folder; whatever is there is deleted at the end.
class ScratchImages {
 public:
  /// Throws RuntimeError if there can be no temporary file.
  explicit ScratchImages(Files& files) : files_(files), name_(files.MakeTempFileName()) {}
  ~ScratchImages();
  ScratchImages(const ScratchImages&) = delete;
  ScratchImages& operator=(const ScratchImages&) = delete;

  std::string Folder() const { return name_.substr(0, name_.rfind('/')); }

  /// Names within the folder.
  std::string ProgMem() const { return BaseName() + "-progmem.img"; }
  std::string EeData() const { return BaseName() + "-eedata.img"; }
  std::string Config() const { return BaseName() + "-config.img"; }
  std::string Log() const { return BaseName() + "-verify.log"; }

  std::string PathOf(const std::string& name) const { return Folder() + "/" + name; }
  ImagePaths Paths() const { return {PathOf(ProgMem()), PathOf(EeData()), PathOf(Config())}; }

 private:
  std::string BaseName() const { return name_.substr(name_.rfind('/') + 1); }

  Files& files_;
  const std::string name_;
};
