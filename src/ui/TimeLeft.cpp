#include "ui/TimeLeft.h"

using std::chrono::milliseconds;

std::optional<milliseconds> TimeLeft(milliseconds spent, double done, double whole) {
  constexpr milliseconds tooShortToTell(1000);
  if (done >= whole) {
    return milliseconds::zero();
  }
  if (done <= 0 || spent < tooShortToTell) {
    return std::nullopt;
  }
  return milliseconds(
      static_cast<milliseconds::rep>(static_cast<double>(spent.count()) * (whole - done) / done));
}
