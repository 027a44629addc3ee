#pragma once

#include <array>
#include <cstddef>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "core/text/StringTable.h"

/// What a column of the members' table holds.
enum class ColumnKind { Number, Count, Text, Button, Moment, MemberNumber };

struct MemberColumn {
  const char* Name;  ///< in the table, and as the heading of an exported file
  ColumnKind Kind;
  bool IsHistory = false;  ///< written when games are committed
};

/// All columns but the photo, in the order of the table.
inline constexpr std::array<MemberColumn, 23> MemberColumns = {{
    {"ContactID", ColumnKind::MemberNumber},
    {"DallasID", ColumnKind::Button},
    {"FirstName", ColumnKind::Text},
    {"LastName", ColumnKind::Text},
    {"NickName", ColumnKind::Text},
    {"Clan", ColumnKind::Text},
    {"Birthdate", ColumnKind::Moment},
    {"Address", ColumnKind::Text},
    {"City", ColumnKind::Text},
    {"PostalCode", ColumnKind::Text},
    {"EmailName", ColumnKind::Text},
    {"PhoneNumber", ColumnKind::Text},
    {"DateJoined", ColumnKind::Moment},
    {"LastPlayedDate", ColumnKind::Moment, true},
    {"TotalGamesPlayed", ColumnKind::Count, true},
    {"TotalDamage", ColumnKind::Number, true},
    {"TotalSoldiering", ColumnKind::Number, true},
    {"AverageDamage", ColumnKind::Number, true},
    {"AverageSoldiering", ColumnKind::Number, true},
    {"TotalPrimaryAccuracy", ColumnKind::Number, true},
    {"PriZeroAccuracyCount", ColumnKind::Count, true},
    {"AveragePrimAccuracy", ColumnKind::Number, true},
    {"AverageSecAccuracy", ColumnKind::Number, true},
}};

/// Places of some columns in that table.
namespace MemberPlace {
inline constexpr std::size_t ContactId = 0;
inline constexpr std::size_t DallasId = 1;
inline constexpr std::size_t FirstName = 2;
inline constexpr std::size_t LastName = 3;
inline constexpr std::size_t NickName = 4;
inline constexpr std::size_t Birthdate = 6;
inline constexpr std::size_t DateJoined = 12;
}  // namespace MemberPlace

/// What the operator calls each of the columns, in their order.
std::vector<std::string> MemberColumnTitles(const StringTable& strings);

/// The column that a heading means: its name, its title in either language or another usual word, in any
/// case, whatever blanks and marks stand between. Nothing for any other heading.
std::optional<std::size_t> ColumnOfHeading(std::string_view heading);
