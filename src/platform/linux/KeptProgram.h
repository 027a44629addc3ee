#pragma once

#include <string>

#include "platform/linux/Descriptor.h"

/// A program, or a module, of ours as it was when this one started. An update replaces the files under a
/// program that runs; what that starts later must still understand it.
class KeptProgram {
 public:
  /// Keeps hold of the file `name`, where it is there.
  explicit KeptProgram(std::string name);

  /// The path it was given.
  const std::string& Name() const { return name_; }

  /// The path at which this process and its children find the file that was there at first: its name, or
  /// another once the name stands for another file or for none.
  std::string Path() const;

 private:
  std::string name_;
  Descriptor held_;
};
