#pragma once

#include <cstddef>
#include <deque>
#include <functional>
#include <ostream>
#include <stdexcept>
#include <string>
#include <vector>

#include "platform/MessageBoxes.h"

/// Records every box and answers it from a script.
class FakeMessageBoxes : public MessageBoxes {
 public:
  struct Box {
    std::string Text;
    std::string Title;
    BoxIcon Icon = BoxIcon::None;
    BoxButtons Buttons = BoxButtons::Ok;

    bool operator==(const Box&) const = default;
    friend std::ostream& operator<<(std::ostream& out, const Box& box) {
      static constexpr const char* icons[] = {"no icon", "information", "question", "exclamation",
                                              "critical"};
      static constexpr const char* buttons[] = {"OK", "OK+Cancel", "Yes+No", "Yes+No+Cancel"};
      return out << '"' << box.Text << "\" (title \"" << box.Title << "\", " << icons[int(box.Icon)] << ", "
                 << buttons[int(box.Buttons)] << ')';
    }
  };

  /// All boxes so far, in the order in which they opened.
  std::vector<Box> Boxes;

  /// Answers to the next questions, in order. When they run out, the default button (OK, Yes) is pressed. A
  /// box with only an OK button uses none of them.
  std::deque<BoxAnswer> Answers;

  /// Called while a box is open, with the box; may press buttons, open further boxes or add answers.
  std::function<void(const Box&)> WhileOpen;

  /// More boxes than any test opens: a box that keeps coming back then ends its test.
  static constexpr std::size_t MostBoxes = 1000;

  BoxAnswer Show(const std::string& text, const std::string& title, BoxIcon icon,
                 BoxButtons buttons = BoxButtons::Ok) override {
    if (Boxes.size() >= MostBoxes) {
      throw std::logic_error("There is no end of boxes: \"" + text + "\"");
    }
    const Box box{text, title, icon, buttons};
    Boxes.push_back(box);
    if (const auto whileOpen = WhileOpen) {
      whileOpen(box);
    }
    if (buttons == BoxButtons::Ok) {
      return BoxAnswer::Ok;
    }
    if (Answers.empty()) {
      return buttons == BoxButtons::OkCancel ? BoxAnswer::Ok : BoxAnswer::Yes;
    }
    const BoxAnswer answer = Answers.front();
    Answers.pop_front();
    if (!HasButton(buttons, answer)) {
      throw std::logic_error("The scripted answer is no button of the box \"" + text + "\"");
    }
    return answer;
  }

 private:
  static bool HasButton(BoxButtons buttons, BoxAnswer answer) {
    switch (answer) {
      case BoxAnswer::Ok:
        return buttons == BoxButtons::Ok || buttons == BoxButtons::OkCancel;
      case BoxAnswer::Cancel:
        return buttons == BoxButtons::OkCancel || buttons == BoxButtons::YesNoCancel;
      default:
        return buttons == BoxButtons::YesNo || buttons == BoxButtons::YesNoCancel;
    }
  }
};
