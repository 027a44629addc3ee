#pragma once

#include <cstdint>
#include <string>

/// Makes a members file of an old installation with `count` rows at `path`: the rows without photographs of
/// `source`, an old file with a few members, over and over, each with a key and a button number of its own.
/// Returns false if `source` is not laid out as expected.
bool MakeManyMembers(const std::string& source, const std::string& path, std::uint32_t count);
