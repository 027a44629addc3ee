#include "ui/AltLetters.h"

#include <QCheckBox>
#include <QDialog>
#include <QEvent>
#include <QFileDialog>
#include <QLabel>
#include <QMainWindow>
#include <QMenuBar>
#include <QPushButton>
#include <QRadioButton>
#include <QShortcutEvent>
#include <vector>

#include "core/text/AltLetters.h"

namespace {

/// The letter of the menu of our additions, which a main window may not have yet.
constexpr const char* ReservedInMainWindow = "W";

bool IsPlainButton(const QWidget& widget) {
  return qobject_cast<const QPushButton*>(&widget) != nullptr ||
         qobject_cast<const QCheckBox*>(&widget) != nullptr ||
         qobject_cast<const QRadioButton*>(&widget) != nullptr;
}

bool LabelsAnEntry(const QWidget& widget) {
  const auto* label = qobject_cast<const QLabel*>(&widget);
  return label != nullptr && label->buddy() != nullptr && label->buddy()->focusPolicy() != Qt::NoFocus &&
         label->textFormat() != Qt::RichText;
}

QString CaptionOf(const QWidget& widget) {
  return widget.property("text").toString();
}

/// Sets a caption with its letter. One that had to be lengthened is not the control's name.
void SetCaption(QWidget& widget, const QString& caption) {
  const QString before = CaptionOf(widget);
  if (caption == before) {
    return;
  }
  widget.setProperty("text", caption);
  if (QString(caption).remove(u'&') != QString(before).remove(u'&')) {
    const auto* label = qobject_cast<QLabel*>(&widget);
    for (QWidget* named : {&widget, label != nullptr ? label->buddy() : &widget}) {
      if (named->accessibleName().isEmpty()) {
        named->setAccessibleName(before);
      }
    }
  }
}

/// Letters that the menus of a main window have.
std::string LettersOfMenus(const QMainWindow& window) {
  std::string letters = ReservedInMainWindow;
  for (const QAction* menu :
       window.menuWidget() != nullptr ? window.menuWidget()->actions() : QList<QAction*>()) {
    const QString text = menu->text();
    if (const auto mark = text.indexOf(u'&'); mark >= 0 && mark + 1 < text.size()) {
      letters += text.mid(mark + 1, 1).toStdString();
    }
  }
  return letters;
}

void GiveLetters(QWidget& window, const std::string& taken) {
  std::vector<QWidget*> controls;
  std::vector<std::string> captions;
  for (QWidget* widget : window.findChildren<QWidget*>()) {
    // A hidden control that keeps its place is shown later.
    const bool isShown = !widget->isHidden() || widget->sizePolicy().retainSizeWhenHidden();
    const bool isOwn = widget->window() == &window && isShown;
    if (isOwn && (IsPlainButton(*widget) || LabelsAnEntry(*widget)) && !CaptionOf(*widget).isEmpty()) {
      controls.push_back(widget);
      captions.push_back(CaptionOf(*widget).toStdString());
    }
  }
  captions = WithAltLetters(captions, taken);
  for (std::size_t i = 0; i < controls.size(); ++i) {
    SetCaption(*controls[i], QString::fromStdString(captions[i]));
  }
}

/// The toolkit sets a check box 100 ms after its letter, and Return would take the entries without it.
bool SetAtOnce(QObject& watched, const QShortcutEvent& shortcut) {
  auto* box = qobject_cast<QCheckBox*>(&watched);
  if (box == nullptr || shortcut.isAmbiguous()) {
    return false;
  }
  box->setFocus(Qt::ShortcutFocusReason);
  box->click();
  return true;
}

}  // namespace

bool AltLetters::eventFilter(QObject* watched, QEvent* event) {
  if (event->type() == QEvent::Shortcut && SetAtOnce(*watched, *static_cast<QShortcutEvent*>(event))) {
    return true;
  }
  if (event->type() == QEvent::Polish && watched->isWidgetType()) {
    auto& widget = *static_cast<QWidget*>(watched);
    if (const auto* mainWindow = qobject_cast<QMainWindow*>(watched)) {
      GiveLetters(widget, LettersOfMenus(*mainWindow));
    } else if (qobject_cast<QDialog*>(watched) != nullptr && qobject_cast<QFileDialog*>(watched) == nullptr) {
      GiveLetters(widget, {});
    }
  }
  return QObject::eventFilter(watched, event);
}
