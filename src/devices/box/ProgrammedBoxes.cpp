#include "devices/box/ProgrammedBoxes.h"

void ProgrammedBoxes::Add(const ProgrammedBox& box) {
  if (boxes_.size() == Most) {
    boxes_.erase(boxes_.begin());
  }
  boxes_.push_back(box);
  ++count_;
}
