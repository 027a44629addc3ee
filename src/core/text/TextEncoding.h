#pragma once

#include <cstddef>
#include <string>
#include <string_view>

/// True when `text` is well-formed UTF-8: no overlong forms, no surrogates, nothing above U+10FFFF.
bool IsUtf8(std::string_view text);

/// `text` of code page 1252 as UTF-8. The five bytes that the code page leaves undefined become U+0081 and so
/// on.
std::string Windows1252ToUtf8(std::string_view text);

/// Number of characters (code points) of a text in UTF-8.
std::size_t CharacterCount(std::string_view text);

/// Up to `count` characters of a text in UTF-8 from the one at `first`, counted from 0.
std::string Characters(std::string_view text, std::size_t first, std::size_t count);

/// The first `most` bytes of a text in UTF-8, or fewer where these would cut a character.
std::string_view FirstBytes(std::string_view text, std::size_t most);
