#pragma once

#include <string>
#include <string_view>

/// `text` for the contents or a quoted attribute of an HTML page: every character that could end or begin
/// markup is escaped, and bytes that are no UTF-8 and characters that a page may not hold become U+FFFD. Line
/// breaks and tabs become blanks.
std::string HtmlText(std::string_view text);

/// The same for a name or another text of unknown direction: it turns nothing around that stands beside it.
std::string HtmlName(std::string_view text);

/// A table's header over a column of numbers or texts, and a cell of either kind. `html` is markup.
std::string HtmlNumberHead(std::string_view html);
std::string HtmlTextHead(std::string_view html);
std::string HtmlNumberCell(std::string_view html);
std::string HtmlTextCell(std::string_view html);
