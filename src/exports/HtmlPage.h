#pragma once

#include <string>
#include <string_view>

#include "core/text/StringTable.h"

/// A whole HTML page in the language of `language`: one file without scripts and outside parts, light or dark
/// as the reader's desktop, on A4 when it is printed. `title` is plain text, `body` markup.
std::string HtmlPage(std::string_view title, std::string_view body, Language language);
