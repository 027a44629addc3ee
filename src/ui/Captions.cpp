#include "ui/Captions.h"

#include <QAbstractButton>
#include <QAction>
#include <QGroupBox>
#include <QLabel>

#include "ui/Text.h"

namespace {

void SetCaption(QWidget& control, const QString& caption) {
  if (auto* group = qobject_cast<QGroupBox*>(&control)) {
    group->setTitle(caption);
  } else if (auto* button = qobject_cast<QAbstractButton*>(&control)) {
    button->setText(caption);
  } else if (auto* label = qobject_cast<QLabel*>(&control)) {
    label->setText(caption);
  } else {
    control.setWindowTitle(caption);
  }
}

QString WithAltLetterOf(const QString& design, QString caption) {
  const auto mark = design.indexOf(u'&');
  const bool hasLetter = mark >= 0 && mark + 1 < design.size();
  const auto letter = hasLetter ? caption.indexOf(design[mark + 1], 0, Qt::CaseInsensitive) : -1;
  if (letter >= 0) {
    caption.insert(letter, u'&');
  }
  return caption;
}

}  // namespace

void SetCaptions(const StringTable& strings, std::initializer_list<std::pair<QWidget*, int>> captions) {
  for (const auto& [control, number] : captions) {
    SetCaption(*control, Text(strings, number));
  }
}

void SetCaptions(const StringTable& strings, std::initializer_list<std::pair<QAction*, int>> captions) {
  for (const auto& [action, number] : captions) {
    action->setText(WithAltLetterOf(action->text(), Text(strings, number)));
  }
}
