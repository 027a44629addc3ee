#include "app/AfterGameBar.h"

#include <QAction>
#include <QEvent>
#include <QHBoxLayout>
#include <QStyleOptionToolButton>
#include <QToolButton>
#include <utility>

#include "app/StepSigns.h"
#include "ui/Text.h"

namespace {

constexpr int Side = 16;  ///< pixels left and right
constexpr int Gap = 6;    ///< pixels between buttons
constexpr int SignSide = 24;

constexpr std::array<std::pair<const char*, OwnText>, GameStepCount> Buttons = {
    {{"BarResults", OwnText::BarResults},
     {"BarPrint", OwnText::BarPrint},
     {"BarCommit", OwnText::BarCommit},
     {"BarSave", OwnText::BarSave},
     {"BarClear", OwnText::BarClear}}};

class BarButton : public QToolButton {
 public:
  using QToolButton::QToolButton;

  /// Width that the toolkit gives the button with or without its caption, whichever it shows now.
  int WidthWith(Qt::ToolButtonStyle shown) const {
    constexpr int beforeText = 4;
    QStyleOptionToolButton option;
    initStyleOption(&option);
    option.toolButtonStyle = shown;
    QSize contents = iconSize();
    if (shown == Qt::ToolButtonTextBesideIcon) {
      const int caption = fontMetrics().size(Qt::TextShowMnemonic, text()).width() +
                          2 * fontMetrics().horizontalAdvance(u' ');
      contents.rwidth() += beforeText + caption;
    }
    return style()->sizeFromContents(QStyle::CT_ToolButton, &option, contents, this).width();
  }
};

/// What the item says in its menu, and its key: "Save Game (Ctrl+S)".
QString TipOf(const QAction& item) {
  QString text = item.text();
  const auto suffix = text.indexOf(QStringLiteral("(&"));
  text = (suffix > 0 ? text.left(suffix) : text).remove(u'&');
  return text + QStringLiteral(" (") + item.shortcut().toString(QKeySequence::NativeText) + u')';
}

}  // namespace

AfterGameBar::AfterGameBar(QWidget* parent) : QFrame(parent) {
  constexpr int above = 4;
  auto* row = new QHBoxLayout(this);
  row->setContentsMargins(Side, above, Side, above);
  row->setSpacing(Gap);
  row->addStretch(1);
}

void AfterGameBar::SetUp(const StringTable& strings, const std::array<QAction*, GameStepCount>& items) {
  strings_ = &strings;
  auto* row = static_cast<QHBoxLayout*>(layout());
  for (int i = 0; i < GameStepCount; ++i) {
    const auto at = static_cast<std::size_t>(i);
    auto* button = new BarButton(this);
    button->setObjectName(QString::fromUtf8(Buttons[at].first));
    button->setText(Text(strings, Buttons[at].second));
    button->setAccessibleName(button->text());
    button->setIconSize({SignSide, SignSide});
    button->setFocusPolicy(Qt::TabFocus);
    QAction* item = items[at];
    steps_[at] = {button, item, false};
    const auto step = static_cast<GameStep>(i);
    connect(button, &QToolButton::clicked, item, &QAction::trigger);
    connect(item, &QAction::changed, this, [this, step] { ShowStep(step); });
    row->insertWidget(i, button);
    ShowStep(step);
  }
  FitCaptions();
}

void AfterGameBar::SetDone(GameStep step, bool done) {
  if (Step& changed = steps_[static_cast<std::size_t>(step)]; changed.IsDone != done) {
    changed.IsDone = done;
    ShowStep(step);
  }
}

void AfterGameBar::ShowStep(GameStep step) {
  const Step& shown = steps_[static_cast<std::size_t>(step)];
  shown.Button->setEnabled(shown.Item->isEnabled());
  const QColor colour = palette().color(QPalette::WindowText);
  shown.Button->setIcon(StepSign(step, shown.IsDone, colour));
  const QString done = shown.IsDone ? Text(*strings_, OwnText::BarDone) : QString();
  shown.Button->setAccessibleDescription(done);
  shown.Button->setToolTip(done.isEmpty() ? TipOf(*shown.Item) : TipOf(*shown.Item) + u'\n' + done);
}

void AfterGameBar::SetEnd(QWidget* end) {
  end_ = end;
  end_->hide();
  static_cast<QHBoxLayout*>(layout())->addWidget(end_);
}

void AfterGameBar::SetEndWanted(bool isWanted) {
  isEndWanted_ = isWanted;
  ShowEnd();
}

void AfterGameBar::ShowEnd() {
  if (end_ != nullptr) {
    end_->setVisible(isEndWanted_ && NeededWidth(true) + Gap + end_->sizeHint().width() <= width());
  }
}

QSize AfterGameBar::minimumSizeHint() const {
  return strings_ == nullptr ? QFrame::minimumSizeHint()
                             : QSize(NeededWidth(false), layout()->minimumSize().height());
}

void AfterGameBar::resizeEvent(QResizeEvent* event) {
  QFrame::resizeEvent(event);
  FitCaptions();
}

void AfterGameBar::changeEvent(QEvent* event) {
  QFrame::changeEvent(event);
  if (event->type() == QEvent::PaletteChange && strings_ != nullptr) {
    for (int i = 0; i < GameStepCount; ++i) {
      ShowStep(static_cast<GameStep>(i));
    }
  }
}

void AfterGameBar::FitCaptions() {
  if (strings_ == nullptr) {
    return;
  }
  ShowEnd();
  const Qt::ToolButtonStyle style =
      NeededWidth(true) <= width() ? Qt::ToolButtonTextBesideIcon : Qt::ToolButtonIconOnly;
  for (const Step& step : steps_) {
    step.Button->setToolButtonStyle(style);
  }
}

int AfterGameBar::NeededWidth(bool captions) const {
  int width = 2 * Side + (GameStepCount - 1) * Gap;
  for (const Step& step : steps_) {
    width += static_cast<const BarButton*>(step.Button)
                 ->WidthWith(captions ? Qt::ToolButtonTextBesideIcon : Qt::ToolButtonIconOnly);
  }
  return width;
}
