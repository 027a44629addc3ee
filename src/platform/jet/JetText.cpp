#include "platform/jet/JetText.h"

#include <cstddef>

#include "platform/Utf8.h"

namespace {

constexpr std::string_view CompressionMark = "\xFF\xFE";
constexpr char32_t Replacement = 0xFFFD;

/// Takes UTF-16 units one by one.
class Utf16Decoder {
 public:
  explicit Utf16Decoder(std::size_t units) { text_.Utf8.reserve(units); }

  void Take(char32_t unit) {
    const bool isLow = unit >= 0xDC00 && unit < 0xE000;
    if (high_ != 0 && isLow) {
      Utf8::Append(text_.Utf8, 0x10000 + ((high_ - 0xD800) << 10U) + (unit - 0xDC00));
      high_ = 0;
      return;
    }
    EndPair();
    if (unit >= 0xD800 && unit < 0xDC00) {
      high_ = unit;
    } else if (isLow) {
      TakeStray();
    } else {
      Utf8::Append(text_.Utf8, unit);
    }
  }

  void TakeStray() {
    Utf8::Append(text_.Utf8, Replacement);
    text_.Whole = false;
  }

  JetText Finish() {
    EndPair();
    return std::move(text_);
  }

 private:
  void EndPair() {
    if (high_ != 0) {
      TakeStray();
      high_ = 0;
    }
  }

  JetText text_;
  char32_t high_ = 0;  ///< first half of a character beyond U+FFFF
};

char32_t UnitAt(std::string_view bytes, std::size_t at) {
  return static_cast<unsigned char>(bytes[at]) |
         (static_cast<char32_t>(static_cast<unsigned char>(bytes[at + 1])) << 8U);
}

JetText DecodeCompressed(std::string_view bytes) {
  Utf16Decoder decoder(bytes.size());
  bool compressed = true;
  for (std::size_t at = 0; at < bytes.size();) {
    if (bytes[at] == '\0') {
      compressed = !compressed;
      ++at;
    } else if (compressed) {
      decoder.Take(static_cast<unsigned char>(bytes[at++]));
    } else if (at + 1 < bytes.size()) {
      decoder.Take(UnitAt(bytes, at));
      at += 2;
    } else {
      decoder.TakeStray();
      ++at;
    }
  }
  return decoder.Finish();
}

}  // namespace

JetText DecodeJetText(std::string_view bytes) {
  if (bytes.starts_with(CompressionMark)) {
    return DecodeCompressed(bytes.substr(CompressionMark.size()));
  }
  Utf16Decoder decoder(bytes.size());
  for (std::size_t at = 0; at + 1 < bytes.size(); at += 2) {
    decoder.Take(UnitAt(bytes, at));
  }
  if (bytes.size() % 2 != 0) {
    decoder.TakeStray();
  }
  return decoder.Finish();
}
