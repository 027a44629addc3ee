#pragma once

#include <filesystem>
#include <string>
#include <string_view>

/// The result of `query`, which gives one text column, with a line break behind each row. Throws
/// std::runtime_error if the file fails an integrity check. As every reader does after a crash, it first
/// brings an unfinished change to an end.
std::string RowsOf(const std::filesystem::path& database, const std::string& query);

/// Runs SQL that changes a database. Throws std::runtime_error.
void ChangeDatabase(const std::filesystem::path& database, const std::string& sql);

/// Throws std::runtime_error if there are more copies than are to be kept, or a damaged one.
void CheckBackups(const std::filesystem::path& folder);

/// Tells contents apart; not a check value of any format.
std::string DigestOf(std::string_view bytes);

/// All bytes of a file; empty if it is missing.
std::string BytesOf(const std::filesystem::path& file);
