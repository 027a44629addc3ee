#include "platform/qt/QtSerialDevices.h"

#include <sys/stat.h>

#include <QSerialPortInfo>
#include <algorithm>
#include <string_view>

#include "platform/Letters.h"

namespace {

/// Removes the run of digits at the start of `text` and returns it without leading zeros.
std::string_view TakeNumber(std::string_view& text) {
  const auto end = std::find_if_not(text.begin(), text.end(), IsDigit);
  std::string_view number = text.substr(0, static_cast<std::size_t>(end - text.begin()));
  text.remove_prefix(number.size());
  number.remove_prefix(std::min(number.find_first_not_of('0'), number.size()));
  return number;
}

}  // namespace

bool NaturalLess(const std::string& left, const std::string& right) {
  std::string_view a = left;
  std::string_view b = right;
  while (!a.empty() && !b.empty()) {
    if (IsDigit(a.front()) && IsDigit(b.front())) {
      const std::string_view numberA = TakeNumber(a);
      const std::string_view numberB = TakeNumber(b);
      if (numberA != numberB) {
        return numberA.size() != numberB.size() ? numberA.size() < numberB.size() : numberA < numberB;
      }
    } else if (a.front() != b.front()) {
      return a.front() < b.front();
    } else {
      a.remove_prefix(1);
      b.remove_prefix(1);
    }
  }
  if (a.empty() != b.empty()) {
    return a.empty();
  }
  return left < right;
}

std::vector<std::string> QtSerialDevices::Names() const {
  std::vector<std::string> names;
  for (const QSerialPortInfo& port : QSerialPortInfo::availablePorts()) {
    names.push_back(port.systemLocation().toStdString());
  }
  std::sort(names.begin(), names.end(), NaturalLess);
  return names;
}

bool QtSerialDevices::Exists(const std::string& device) const {
  struct stat status {};
  return ::stat(device.c_str(), &status) == 0 && S_ISCHR(status.st_mode);
}
