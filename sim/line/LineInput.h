#pragma once

#include <string>
#include <vector>

namespace sim {

/// Cuts what comes in over a file descriptor into lines.
class LineInput {
 public:
  /// `descriptor` stays the caller's.
  explicit LineInput(int descriptor) : descriptor_(descriptor) {}

  /// Waits for input unless some is there and returns the lines that it completes, without their ends; at the
  /// end of the input also a last line that has none.
  std::vector<std::string> Read();
  /// No more will come.
  bool HasEnded() const { return ended_; }

 private:
  int descriptor_;
  std::string begun_;
  bool ended_ = false;
};

}  // namespace sim
