#pragma once

#include <string>

inline constexpr const char* AllMembers = "SELECT * FROM Members";

/// The members one of whose three names begins with `text`, by the database's own matching rules; all of them
/// for an empty text. The text goes in as it stands, so that an apostrophe makes a query that cannot be read.
std::string SearchQuery(const std::string& text);

/// The members with exactly these first and last names.
std::string NameQuery(const std::string& firstName, const std::string& lastName);

/// The members with this button.
std::string ButtonQuery(const std::string& dallasId);
