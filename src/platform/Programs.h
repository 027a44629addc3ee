#pragma once

#include <string>
#include <vector>

/// Other programs of this computer.
class Programs {
 public:
  virtual ~Programs() = default;

  /// Starts a program that runs on its own and may outlive this one. The first of `words` is the program: a
  /// path, or a name that is looked up among the system's programs. The others are its arguments, passed
  /// unchanged. Throws RuntimeError 53 if it cannot be started, 5 if `words` is empty.
  virtual void Start(const std::vector<std::string>& words) = 0;
};
