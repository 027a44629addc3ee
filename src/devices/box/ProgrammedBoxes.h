#pragma once

#include <string>
#include <vector>

#include "devices/box/BoxFrame.h"

/// How a press of the button ended.
enum class BoxResult {
  Accepted,
  Rejected,
  NoResponse,
  Unconfirmed,  ///< the frame went out, but the line failed or the window closed before an answer
  NotSent       ///< not, or not whole
};

/// A box to which a whole frame was sent.
struct ProgrammedBox {
  std::string Time;  ///< "HH:MM:SS"
  BoxEntries Entries;
  BoxResult Result;
};

/// The last boxes of this run of the program, oldest first.
class ProgrammedBoxes {
 public:
  /// The oldest ones go when there are more.
  static constexpr std::size_t Most = 500;

  void Add(const ProgrammedBox& box);

  const std::vector<ProgrammedBox>& All() const { return boxes_; }

  /// Boxes added in this run, with those that went.
  std::size_t Count() const { return count_; }

 private:
  std::vector<ProgrammedBox> boxes_;
  std::size_t count_ = 0;
};
