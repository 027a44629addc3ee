#pragma once

#include <string>
#include <string_view>

#include "core/text/StringTable.h"

/// The beginning of an HTML page in the language of `language`: one file without scripts and outside parts,
/// light or dark as the reader's desktop, on A4 when it is printed. `title` is plain text.
std::string HtmlPageStart(std::string_view title, Language language);

/// What stands behind the page's contents.
std::string_view HtmlPageEnd();
