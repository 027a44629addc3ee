#pragma once

#include <string>
#include <string_view>

/// `text` as it may stand in a page, between tags or in an attribute in double quotes. Characters that markup
/// uses are written as references; left out are controls, marks that turn the direction of writing, bytes
/// that are no UTF-8, and what is no character. A tab or the end of a line becomes a blank.
std::string Escaped(std::string_view text);

/// The same in an element that keeps the direction of its letters from what stands beside it.
std::string Isolated(std::string_view text);
