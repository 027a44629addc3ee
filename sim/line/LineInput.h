#pragma once

#include <string>
#include <vector>

namespace sim {

/// Splits the input from a file descriptor into lines.
class LineInput {
 public:
  /// The caller keeps ownership of `descriptor`.
  explicit LineInput(int descriptor) : descriptor_(descriptor) {}

  /// Waits for input if there is none and returns the lines that it completes, without their line ends; at
  /// the end of the input also a last line that lacks one.
  std::vector<std::string> Read();
  /// True once the end of the input was reached.
  bool HasEnded() const { return ended_; }

 private:
  int descriptor_;
  std::string begun_;
  bool ended_ = false;
};

}  // namespace sim
