#pragma once

#include <string>
#include <string_view>

/// What becomes of characters that are not seen, and of bytes that are none.
enum class HtmlUnseen {
  Kept,    ///< marks that turn the direction of writing stay; what a page may not hold becomes U+FFFD
  LeftOut  ///< for pages that anybody may read
};

/// `text` for the contents or a quoted attribute of an HTML page: every character that could end or begin
/// markup is escaped, and line breaks and tabs become blanks. Controls, bytes that are no UTF-8 and what is
/// no character never stand there.
std::string HtmlText(std::string_view text, HtmlUnseen unseen = HtmlUnseen::Kept);

/// The same for a name or another text of unknown direction: it turns nothing around that stands beside it.
std::string HtmlName(std::string_view text, HtmlUnseen unseen = HtmlUnseen::Kept);

/// A table's header over a column of numbers or texts, and a cell of either kind. `html` is markup.
std::string HtmlNumberHead(std::string_view html);
std::string HtmlTextHead(std::string_view html);
std::string HtmlNumberCell(std::string_view html);
std::string HtmlTextCell(std::string_view html);
