#pragma once

#include <gtest/gtest.h>

#include <QAbstractButton>
#include <QAbstractItemView>
#include <QAbstractSpinBox>
#include <QComboBox>
#include <QCoreApplication>
#include <QGroupBox>
#include <QHeaderView>
#include <QLabel>
#include <QLineEdit>
#include <QPlainTextEdit>
#include <QProgressBar>
#include <QTextEdit>
#include <QWidget>
#include <vector>

// What must hold for every window, in both languages.

/// The controls of `window` that the operator writes into or chooses from.
inline std::vector<QWidget*> EntriesOf(const QWidget& window) {
  std::vector<QWidget*> entries;
  for (QWidget* widget : window.findChildren<QWidget*>()) {
    const bool isEntry =
        qobject_cast<QLineEdit*>(widget) != nullptr || qobject_cast<QComboBox*>(widget) != nullptr ||
        qobject_cast<QAbstractItemView*>(widget) != nullptr || qobject_cast<QTextEdit*>(widget) != nullptr ||
        qobject_cast<QPlainTextEdit*>(widget) != nullptr ||
        qobject_cast<QAbstractSpinBox*>(widget) != nullptr;
    const bool isPartOfAnother = qobject_cast<QComboBox*>(widget->parentWidget()) != nullptr ||
                                 qobject_cast<QAbstractSpinBox*>(widget->parentWidget()) != nullptr ||
                                 qobject_cast<QHeaderView*>(widget) != nullptr ||
                                 widget->objectName().startsWith(QStringLiteral("qt_"));
    if (isEntry && !isPartOfAnother && widget->isVisibleTo(&window)) {
      entries.push_back(widget);
    }
  }
  return entries;
}

/// A screen reader knows each entry by its label or by an accessible name.
inline void ExpectEntriesAreNamed(const QWidget& window) {
  for (const QWidget* entry : EntriesOf(window)) {
    bool named = !entry->accessibleName().isEmpty();
    for (const QLabel* label : window.findChildren<QLabel*>()) {
      named |= label->buddy() == entry && !label->text().isEmpty();
    }
    EXPECT_TRUE(named) << window.objectName().toStdString() << ": " << entry->objectName().toStdString();
  }
}

/// No caption is cut off, and none is outside the window.
inline void ExpectCaptionsFit(const QWidget& window) {
  for (const QWidget* widget : window.findChildren<QWidget*>()) {
    const auto* label = qobject_cast<const QLabel*>(widget);
    const auto* button = qobject_cast<const QAbstractButton*>(widget);
    const bool hasCaption = (label != nullptr && !label->text().isEmpty()) ||
                            (button != nullptr && !button->text().isEmpty()) ||
                            qobject_cast<const QGroupBox*>(widget) != nullptr;
    if (!hasCaption || !widget->isVisible()) {
      continue;
    }
    const std::string name = window.objectName().toStdString() + ": " + widget->objectName().toStdString();
    if (label != nullptr && label->wordWrap()) {
      EXPECT_GE(widget->height(), label->heightForWidth(widget->width())) << name;
    } else {
      EXPECT_GE(widget->width(), widget->minimumSizeHint().width()) << name;
      EXPECT_GE(widget->height(), widget->minimumSizeHint().height()) << name;
    }
    const QRect place(widget->mapTo(&window, QPoint(0, 0)), widget->size());
    EXPECT_TRUE(window.rect().contains(place)) << name;
  }
}

/// The Tab key goes through the window in reading order.
inline void ExpectTabOrderFollowsTheEye(const QWidget& window) {
  const auto takesTab = [&window](const QWidget* widget) {
    return (widget->focusPolicy() & Qt::TabFocus) != 0 && widget->isVisibleTo(&window) && widget->isEnabled();
  };
  std::vector<const QWidget*> chain;
  const QWidget* first = &window;
  for (const QWidget* widget = first->nextInFocusChain(); widget != first;
       widget = widget->nextInFocusChain()) {
    if (widget->window() == &window && takesTab(widget)) {
      chain.push_back(widget);
    }
  }
  const auto placeOf = [&window](const QWidget* widget) { return widget->mapTo(&window, QPoint(0, 0)); };
  for (std::size_t i = 1; i < chain.size(); ++i) {
    const QPoint before = placeOf(chain[i - 1]);
    const QPoint after = placeOf(chain[i]);
    const bool follows = after.y() + chain[i]->height() > before.y() || after.x() > before.x();
    EXPECT_TRUE(follows) << window.objectName().toStdString() << ": " << chain[i]->objectName().toStdString()
                         << " comes after " << chain[i - 1]->objectName().toStdString();
  }
}

/// All of the above, for a window that is shown, and that it fits on the smallest supported screen.
inline void ExpectCaredFor(const QWidget& window) {
  QCoreApplication::processEvents();  // layouts follow new texts
  ExpectEntriesAreNamed(window);
  ExpectCaptionsFit(window);
  ExpectTabOrderFollowsTheEye(window);
  EXPECT_LE(window.minimumSizeHint().width(), 1024) << window.objectName().toStdString();
  EXPECT_LE(window.minimumSizeHint().height(), 768 - 33) << window.objectName().toStdString();
}
