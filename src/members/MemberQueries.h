#pragma once

#include <string>

inline constexpr const char* AllMembers = "SELECT * FROM Members";

/// Selects the members with a first name, last name or nickname that begins with `text`, by the database's
/// matching rules; an empty text selects all. The text is not escaped: a single apostrophe makes the query
/// malformed.
std::string SearchQuery(const std::string& text);

/// Selects the same members, but an apostrophe in `text` is a letter like any other.
std::string HitsQuery(const std::string& text);

/// Selects the members with exactly these first and last names.
std::string NameQuery(const std::string& firstName, const std::string& lastName);

/// Selects the members with this button.
std::string ButtonQuery(const std::string& dallasId);
