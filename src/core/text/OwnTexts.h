#pragma once

/// Names of the texts beyond the captions and messages numbered up to 218. Their words are in the string
/// table, resources/StringTable.inc; a new text is added there, under the next free number of its area.
enum class OwnText {
#define OWN_TEXT(number, name, english, simplifiedChinese) name = (number),
#include "resources/StringTable.inc"
};
