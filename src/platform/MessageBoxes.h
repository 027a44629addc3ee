#pragma once

#include <string>

enum class BoxIcon { None, Information, Question, Exclamation, Critical };
enum class BoxButtons { Ok, OkCancel, YesNo, YesNoCancel };
enum class BoxAnswer { Ok, Cancel, Yes, No };

/// Title of every box that has none of its own.
inline constexpr const char* DefaultBoxTitle = "Tessarine";

/// Modal message boxes.
class MessageBoxes {
 public:
  virtual ~MessageBoxes() = default;

  /// Shows a box and returns the button that closed it. Escape and the close box answer Cancel where there is
  /// such a button, else Ok; a box of nothing but Yes and No closes by its buttons alone. A box whose window
  /// is destroyed answers as its last button does.
  virtual BoxAnswer Show(const std::string& text, const std::string& title, BoxIcon icon,
                         BoxButtons buttons = BoxButtons::Ok) = 0;
};
