#pragma once

#include <string>

enum class BoxIcon { None, Information, Question, Exclamation, Critical };
enum class BoxButtons { Ok, OkCancel, YesNo };
enum class BoxAnswer { Ok, Cancel, Yes, No };

/// Title of every box that has none of its own.
inline constexpr const char* DefaultBoxTitle = "Tessarine";

/// Modal message boxes.
class MessageBoxes {
 public:
  virtual ~MessageBoxes() = default;

  /// Shows a box and returns the button that closed it. The close box answers Cancel (OkCancel), No (YesNo)
  /// or Ok.
  virtual BoxAnswer Show(const std::string& text, const std::string& title, BoxIcon icon,
                         BoxButtons buttons = BoxButtons::Ok) = 0;
};
