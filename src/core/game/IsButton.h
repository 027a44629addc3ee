#pragma once

#include <string_view>

/// True if a button's text in a record or a table is that of a button. Game files that do not tell the button
/// are read as "0", others have NoDallasId or nothing.
inline bool IsButton(std::string_view text) {
  return text.find_first_not_of("0 ") != std::string_view::npos;
}
