#pragma once

#include <string>
#include <string_view>

/// A text of a Jet file as UTF-8.
struct JetText {
  std::string Utf8;
  bool Whole = true;  ///< false: U+FFFD stands for bytes that are no characters
};

/// Decodes a text as files since version 4 store it: UTF-16, little-endian, or compressed. A compressed text
/// begins with FF FE and has one byte for each character below U+0100; a zero byte switches to two bytes for
/// each character, and back.
JetText DecodeJetText(std::string_view bytes);
