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

  /// Shows a box and returns the button that closed it. Escape and the close box count as Cancel if there is
  /// such a button, else as Ok; a box with only Yes and No can be closed only by its buttons. A box whose
  /// window is destroyed returns its last button.
  virtual BoxAnswer Show(const std::string& text, const std::string& title, BoxIcon icon,
                         BoxButtons buttons = BoxButtons::Ok) = 0;
};
