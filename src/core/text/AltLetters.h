#pragma once

#include <string>
#include <string_view>
#include <vector>

/// The captions of one window, each with a letter for the Alt key, marked by "&" before it, as far as there
/// are letters: first those of captions that have one already, then the first letters of words, then any. No
/// letter is given twice, nor one of `taken`. Behind a caption without Latin letters one is added:
/// "保存(&A)". A caption without any letter, such as an arrow, stays as it is.
std::vector<std::string> WithAltLetters(std::vector<std::string> captions, std::string_view taken = {});
