#pragma once

#include <gtest/gtest.h>

#include <QLabel>
#include <QVariant>
#include <QWidget>
#include <initializer_list>
#include <string>
#include <utility>

#include "tests/support/Controls.h"

/// What stands on a label, button, check box or frame.
inline std::string CaptionOf(const QWidget& control) {
  const QVariant text = control.property("text");
  return (text.isValid() ? text : control.property("title")).toString().toStdString();
}

/// Each control of `window` by name, with what stands on it.
inline void ExpectCaptions(const QWidget& window,
                           std::initializer_list<std::pair<const char*, std::string>> captions) {
  for (const auto& [control, caption] : captions) {
    EXPECT_EQ(CaptionOf(Find<QWidget>(window, control)), caption) << control;
  }
}

/// The text of the one label that belongs to a control; empty without one.
inline std::string LabelOf(const QWidget& window, const QWidget& control) {
  std::string text;
  int labels = 0;
  for (const QLabel* label : window.findChildren<QLabel*>()) {
    if (label->buddy() == &control) {
      text = label->text().toStdString();
      ++labels;
    }
  }
  EXPECT_LE(labels, 1) << control.objectName().toStdString();
  return text;
}

/// Each control of `window` by name, with the text of its label.
inline void ExpectLabels(const QWidget& window,
                         std::initializer_list<std::pair<const char*, std::string>> labels) {
  for (const auto& [control, label] : labels) {
    EXPECT_EQ(LabelOf(window, Find<QWidget>(window, control)), label) << control;
  }
}
