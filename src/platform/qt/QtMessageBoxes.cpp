#include "platform/qt/QtMessageBoxes.h"

#include <QCloseEvent>
#include <QCursor>
#include <QGuiApplication>
#include <QKeyEvent>
#include <QMessageBox>
#include <QPointer>
#include <vector>

namespace {

/// A question that must be answered: the toolkit would treat Escape and the close box as No.
class QuestionBox : public QMessageBox {
 public:
  explicit QuestionBox(QWidget* parent) : QMessageBox(parent) {
    setWindowFlag(Qt::CustomizeWindowHint);
    setWindowFlag(Qt::WindowCloseButtonHint, false);
  }

 protected:
  void keyPressEvent(QKeyEvent* event) override {
    if (!event->matches(QKeySequence::Cancel)) {
      QMessageBox::keyPressEvent(event);
    }
  }
  void closeEvent(QCloseEvent* event) override { event->ignore(); }
};

/// Takes the hourglass away as long as it exists: a box waits for the operator, not the operator for it.
class OrdinaryPointer {
 public:
  OrdinaryPointer() {
    while (const QCursor* cursor = QGuiApplication::overrideCursor()) {
      covered_.push_back(*cursor);
      QGuiApplication::restoreOverrideCursor();
    }
  }
  ~OrdinaryPointer() {
    for (; !covered_.empty(); covered_.pop_back()) {
      QGuiApplication::setOverrideCursor(covered_.back());
    }
  }
  OrdinaryPointer(const OrdinaryPointer&) = delete;
  OrdinaryPointer& operator=(const OrdinaryPointer&) = delete;

 private:
  std::vector<QCursor> covered_;
};

QMessageBox* NewBox(BoxButtons buttons, QWidget* parent) {
  return buttons == BoxButtons::YesNo ? new QuestionBox(parent) : new QMessageBox(parent);
}

QMessageBox::Icon IconOf(BoxIcon icon) {
  switch (icon) {
    case BoxIcon::Information:
      return QMessageBox::Information;
    case BoxIcon::Question:
      return QMessageBox::Question;
    case BoxIcon::Exclamation:
      return QMessageBox::Warning;
    case BoxIcon::Critical:
      return QMessageBox::Critical;
    case BoxIcon::None:
      break;
  }
  return QMessageBox::NoIcon;
}

void SetButtons(QMessageBox& box, BoxButtons buttons) {
  switch (buttons) {
    case BoxButtons::Ok:
      box.setStandardButtons(QMessageBox::Ok);
      box.setDefaultButton(QMessageBox::Ok);
      break;
    case BoxButtons::OkCancel:
      box.setStandardButtons(QMessageBox::Ok | QMessageBox::Cancel);
      box.setDefaultButton(QMessageBox::Ok);
      break;
    case BoxButtons::YesNo:
      box.setStandardButtons(QMessageBox::Yes | QMessageBox::No);
      box.setDefaultButton(QMessageBox::Yes);
      break;
    case BoxButtons::YesNoCancel:
      box.setStandardButtons(QMessageBox::Yes | QMessageBox::No | QMessageBox::Cancel);
      box.setDefaultButton(QMessageBox::Yes);
      break;
  }
}

BoxAnswer AnswerOf(int pressed, BoxButtons buttons) {
  switch (buttons) {
    case BoxButtons::Ok:
      break;
    case BoxButtons::OkCancel:
      return pressed == QMessageBox::Ok ? BoxAnswer::Ok : BoxAnswer::Cancel;
    case BoxButtons::YesNo:
      return pressed == QMessageBox::Yes ? BoxAnswer::Yes : BoxAnswer::No;
    case BoxButtons::YesNoCancel:
      return pressed == QMessageBox::Yes  ? BoxAnswer::Yes
             : pressed == QMessageBox::No ? BoxAnswer::No
                                          : BoxAnswer::Cancel;
  }
  return BoxAnswer::Ok;
}

}  // namespace

BoxAnswer QtMessageBoxes::Show(const std::string& text, const std::string& title, BoxIcon icon,
                               BoxButtons buttons) {
  // Not on the stack: its parent may be destroyed, and the box with it, while it is open.
  const QPointer<QMessageBox> box = NewBox(buttons, parent_());
  box->setTextFormat(Qt::PlainText);
  box->setText(QString::fromStdString(text));
  box->setWindowTitle(QString::fromStdString(title));
  box->setIcon(IconOf(icon));
  SetButtons(*box, buttons);
  const OrdinaryPointer pointer;
  const int pressed = box->exec();
  delete box;
  return AnswerOf(pressed, buttons);
}
