#pragma once

#include <cstddef>
#include <string>
#include <string_view>

/// True if `text` is well-formed UTF-8: no overlong forms, no surrogates, nothing above U+10FFFF.
bool IsUtf8(std::string_view text);

/// Converts code page 1252 to UTF-8. The five bytes that it leaves undefined become the control characters of
/// the same value (0x81 becomes U+0081).
std::string Windows1252ToUtf8(std::string_view text);

/// Number of characters (code points) in a UTF-8 text.
std::size_t CharacterCount(std::string_view text);

/// Up to `count` characters of a UTF-8 text, starting with character `first` (counted from 0).
std::string Characters(std::string_view text, std::size_t first, std::size_t count);

/// The first `most` bytes of a UTF-8 text, or fewer if that would split a character.
std::string_view FirstBytes(std::string_view text, std::size_t most);
