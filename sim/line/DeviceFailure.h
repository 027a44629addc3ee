#pragma once

#include <algorithm>
#include <array>
#include <cstddef>
#include <string_view>
#include <vector>

namespace sim {

/// What the number that goes with a failure counts, from 1. None: the failure does not look at it.
enum class FailurePlace { None, Frame, Byte, Bit, Gun };

/// A row of a device's table of failures. Each device has an enumeration `Kind` of its own, in which 0 is the
/// faultless device, and a table that has every failure once, in the order of the enumeration.
template <class Kind>
struct FailureInfo {
  Kind Failure;
  std::string_view Name;  ///< for command lines and test names
  FailurePlace Place;
  std::string_view Meaning;
};

/// To be asserted of every table, since its place in the table gives a failure its number.
template <class Info, std::size_t Count>
constexpr bool IsInOrder(const std::array<Info, Count>& table) {
  for (std::size_t i = 0; i < Count; ++i) {
    if (static_cast<std::size_t>(table[i].Failure) != i) {
      return false;
    }
  }
  return true;
}

/// A row of any table.
struct FailureRow {
  std::string_view Name;
  FailurePlace Place;
  std::string_view Meaning;
};

/// A table without its enumeration, for those who serve all devices alike.
template <class Info, std::size_t Count>
std::vector<FailureRow> FailureRows(const std::array<Info, Count>& table) {
  std::vector<FailureRow> rows(Count);
  std::transform(table.begin(), table.end(), rows.begin(), [](const Info& info) {
    return FailureRow{info.Name, info.Place, info.Meaning};
  });
  return rows;
}

}  // namespace sim
