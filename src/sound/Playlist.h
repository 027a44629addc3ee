#pragma once

#include <string>
#include <string_view>
#include <vector>

/// A play list: the path of each row's file in double quotes, one to a line, empty quotes for a row without a
/// file. CRLF, UTF-8.
std::string WritePlaylist(const std::vector<std::string>& paths);

/// The records of a play list, empty ones too. A line without quotes around it is taken as it stands. Reads
/// CRLF and LF, UTF-8 with or without a byte-order mark, and else Windows-1252.
std::vector<std::string> ReadPlaylist(std::string_view bytes);

/// True for a path that a play list gives back as it was: no double quote in it, and no line break.
bool FitsPlaylist(std::string_view path);
