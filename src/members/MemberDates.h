#pragma once

#include <optional>
#include <string>
#include <string_view>

/// In dates that do not begin with the year.
enum class DateOrder { DayFirst, MonthFirst };

/// What a text tells about the order of its day and month.
enum class DateSign {
  NoDate,      ///< it is no date in either order
  Clear,       ///< it is the same date in both: "2001-05-03", "03.03.2001"
  DayFirst,    ///< it is one only so: "23.5.2001"
  MonthFirst,  ///< likewise: "5/23/2001"
  Open,        ///< it is another date in each: "3/5/2001"
};

DateSign SignOf(std::string_view text);

/// "YYYY-MM-DD HH:MM:SS" of a date with or without a time: "2001-05-03", "20010503", "2001年5月3日", and with
/// points, slashes, dashes or blanks in the given order; a year of two digits is one from 1930 to 2029. The
/// time is "20:15", "20:15:30" or "8:15 PM", and 00:00:00 without one. Nothing if it is no date.
std::optional<std::string> StoredMoment(std::string_view text, DateOrder order);

/// A stored date as it is exported: without the time where that is 00:00:00. Any other text as it stands.
std::string_view ExportedMoment(std::string_view stored);
