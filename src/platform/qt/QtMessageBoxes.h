#pragma once

#include <QWidget>
#include <functional>
#include <utility>

#include "platform/MessageBoxes.h"

class QtMessageBoxes : public MessageBoxes {
 public:
  /// `parent` returns the parent window for a box opened now, or null.
  explicit QtMessageBoxes(std::function<QWidget*()> parent) : parent_(std::move(parent)) {}

  BoxAnswer Show(const std::string& text, const std::string& title, BoxIcon icon,
                 BoxButtons buttons = BoxButtons::Ok) override;

 private:
  std::function<QWidget*()> parent_;
};
