#pragma once

#include <algorithm>
#include <array>
#include <cstddef>
#include <string_view>
#include <vector>

namespace sim {

/// What the number given with a failure counts, from 1. None: the failure ignores it.
enum class FailurePlace { None, Frame, Byte, Bit, Gun, Answer, Page, Row };

/// A row of a device's table of failures. Each device has its own enumeration `Kind`, in which 0 is the
/// faultless device, and a table that has every failure once, in the order of the enumeration.
template <class Kind>
struct FailureInfo {
  Kind Failure;
  std::string_view Name;  ///< for command lines and test names
  FailurePlace Place;
  std::string_view Meaning;
};

/// To be asserted for every table: a failure's number is its row.
template <class Info, std::size_t Count>
constexpr bool IsInOrder(const std::array<Info, Count>& table) {
  for (std::size_t i = 0; i < Count; ++i) {
    if (static_cast<std::size_t>(table[i].Failure) != i) {
      return false;
    }
  }
  return true;
}

/// A row of any device's table.
struct FailureRow {
  std::string_view Name;
  FailurePlace Place;
  std::string_view Meaning;
};

/// A table stripped of its enumeration, for code that treats all devices alike.
template <class Info, std::size_t Count>
std::vector<FailureRow> FailureRows(const std::array<Info, Count>& table) {
  std::vector<FailureRow> rows(Count);
  std::transform(table.begin(), table.end(), rows.begin(), [](const Info& info) {
    return FailureRow{info.Name, info.Place, info.Meaning};
  });
  return rows;
}

}  // namespace sim
