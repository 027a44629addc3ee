#pragma once

#include <string>
#include <string_view>

/// `text` as it may stand in a log that is handed on: in one line, and without what could be a person's.
/// Numbers of membership buttons go, and so does what stands in single quotes (a query may hold a name; plain
/// numbers stay) and every path but those of this program's own files in `dataFolder`, of which the name
/// stays. What follows another path in its line goes with it, since blanks do not tell where a path ends.
std::string LogText(std::string_view text, std::string_view dataFolder);
