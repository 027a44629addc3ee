#pragma once

#include <string>
#include <string_view>

#include "exports/HtmlText.h"

/// `text` as it may stand in a public page, between tags or in an attribute in double quotes: nothing unseen
/// is left of it.
inline std::string Escaped(std::string_view text) {
  return HtmlText(text, HtmlUnseen::LeftOut);
}

/// The same in an element that keeps the direction of its letters from what stands beside it.
inline std::string Isolated(std::string_view text) {
  return HtmlName(text, HtmlUnseen::LeftOut);
}
