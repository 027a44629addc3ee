#pragma once

/// Texts beyond the numbered captions and messages up to 218, by name. The string table holds their words:
/// resources/StringTable.inc, which is also where a new one is entered, under the next free number of its
/// area.
enum class OwnText {
#define OWN_TEXT(number, name, english, simplifiedChinese) name = (number),
#include "resources/StringTable.inc"
};
