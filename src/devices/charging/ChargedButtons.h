#pragma once

#include <cstddef>
#include <cstdint>
#include <optional>
#include <string>
#include <vector>

/// How a touch of a button ended.
enum class ChargeResult {
  Charged,      ///< and read back as written
  Different,    ///< written, but not what was read back
  NotReadBack,  ///< written, and gone before it could be read back
  NotRead,      ///< gone or disturbed: not written
  Unknown       ///< of a kind that is not charged: not written
};

struct ChargedButton {
  std::string Time;                  ///< "HH:MM:SS"
  std::optional<std::uint8_t> Kind;  ///< first byte of its block; empty if that was not read
  std::string DallasID;
  ChargeResult Result;
};

/// The last buttons of this run of the program, oldest first.
class ChargedButtons {
 public:
  /// The oldest ones go when there are more.
  static constexpr std::size_t Most = 500;

  /// A button that could not be read is tried again with each pass over the bus. Only the first try in a row
  /// is added; returns false for the others.
  bool Add(const ChargedButton& button);

  /// The buttons have left the reader: the next try is one of a new touch.
  void BeginTouch() { touching_ = false; }

  const std::vector<ChargedButton>& All() const { return buttons_; }

  /// Buttons added in this run, with those that went.
  std::size_t Count() const { return count_; }

 private:
  std::vector<ChargedButton> buttons_;
  std::size_t count_ = 0;
  bool touching_ = false;  ///< the last button may still be at the reader
};
