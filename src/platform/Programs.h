#pragma once

#include <string>
#include <vector>

/// Other programs of this computer.
class Programs {
 public:
  virtual ~Programs() = default;

  /// Starts a program that goes on by itself, also when this one has ended. The first of `words` is the
  /// program: a path, or a name that is looked for where the system's programs lie. The others are its
  /// arguments, each handed over as it stands. Throws RuntimeError 53 when it cannot be started, 5 when there
  /// are no words.
  virtual void Start(const std::vector<std::string>& words) = 0;
};
