#include "ui/TimeLeftText.h"

#include "core/text/Filled.h"
#include "ui/TimeLeft.h"

std::string TimeLeftText(std::chrono::microseconds spent, double done, const StringTable& strings) {
  const auto left = TimeLeft(std::chrono::duration_cast<std::chrono::milliseconds>(spent), done, 1);
  if (!left || done >= 1) {
    return {};
  }
  const auto minutes = std::chrono::round<std::chrono::minutes>(*left).count();
  return minutes == 0 ? strings.Text(OwnText::LessThanMinuteLeft)
                      : Filled(strings.Text(OwnText::MinutesLeft), {std::to_string(minutes)});
}
