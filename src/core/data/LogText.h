#pragma once

#include <string>
#include <string_view>

/// `text` made fit for a log that is passed on: in one line and without personal data. Hides the numbers of
/// membership buttons, anything in single quotes (a query may contain a name) except plain numbers, and
/// paths, of which only the names of this program's own files in `dataFolder` remain. Any other path takes
/// the rest of its line with it, since blanks do not show where a path ends.
std::string LogText(std::string_view text, std::string_view dataFolder);
