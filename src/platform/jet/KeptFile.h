#pragma once

#include <functional>
#include <string>

#include "platform/Files.h"

/// Gives a file a second name; false if the file system has no such thing.
using LinkFile = std::function<bool(const std::string& path, const std::string& newPath)>;

/// Link(2).
bool HardLink(const std::string& path, const std::string& newPath);

/// The file at `path` under a second name, ".jet", ".jet2" and so on behind its own, so that it exists under
/// one of the two at every instant while another one takes its place. Durable. Deleted again at the end
/// unless Keep was called.
class KeptFile {
 public:
  /// Copies the file where links are not possible. Throws as Files::Read and Replace do.
  KeptFile(Files& disk, const std::string& path, const LinkFile& link = HardLink);
  ~KeptFile();
  KeptFile(const KeptFile&) = delete;
  KeptFile& operator=(const KeptFile&) = delete;

  const std::string& Path() const { return path_; }
  void Keep() { stays_ = true; }
  /// Undoes Keep.
  void TakeBack() { stays_ = !isOurs_; }

 private:
  Files& disk_;
  std::string path_;
  bool isOurs_ = true;  ///< false: an interrupted conversion left it
  bool stays_ = false;
};

/// `path` itself or, if that is taken, with the first free number from 2 behind it.
std::string UnusedName(const Files& disk, const std::string& path);
