#include "ui/StatusLine.h"

#include <QLabel>
#include <QPainter>
#include <QToolButton>
#include <initializer_list>
#include <set>

#include "ui/Announce.h"
#include "ui/FlowLayout.h"

namespace {

/// Pixels. Entries of one matter stand closer together than others.
constexpr FlowLayout::Gaps Gaps{.Apart = 20, .Joined = 8, .Lines = 2};

/// Cut in the middle where it is too narrow: a path's end says most.
class PlainText : public QLabel {
 public:
  using QLabel::QLabel;

 protected:
  void paintEvent(QPaintEvent* /*event*/) override {
    QPainter painter(this);
    const QRect place = contentsRect();
    style()->drawItemText(&painter, place, Qt::AlignLeft | Qt::AlignVCenter, palette(), isEnabled(),
                          fontMetrics().elidedText(text(), Qt::ElideMiddle, place.width()), foregroundRole());
  }
};

/// Without the blanks that a button has beside its caption. The toolkit cuts it in the same way.
class LinkText : public QToolButton {
 public:
  using QToolButton::QToolButton;

  QSize sizeHint() const override {
    const QSize button = QToolButton::sizeHint();
    return {button.width() - 2 * fontMetrics().horizontalAdvance(u' '), button.height()};
  }
};

/// Hidden before it is in the layout, so that it never appears as a window of its own.
template <typename Control>
Control* NewControl(const QString& name, QWidget* parent) {
  auto* control = new Control(parent);
  control->setObjectName(name);
  control->hide();
  return control;
}

}  // namespace

StatusLine::StatusLine(QWidget* parent) : QFrame(parent) {
  constexpr int side = 16;
  constexpr int above = 4;
  flow_ = new FlowLayout(this, Gaps);
  flow_->setContentsMargins(side, above, side, above);
}

StatusLine::Controls& StatusLine::ControlsOf(const QString& name) {
  const auto [entry, isNew] = controls_.try_emplace(name);
  Controls& controls = entry->second;
  if (isNew) {
    controls.Plain = NewControl<PlainText>(name, this);
    controls.Plain->setTextFormat(Qt::PlainText);
    controls.Link = NewControl<LinkText>(name + QStringLiteral("Link"), this);
    controls.Link->setFocusPolicy(Qt::TabFocus);
    controls.Link->setAutoRaise(true);
    controls.Link->setCursor(Qt::PointingHandCursor);
    QFont font = controls.Link->font();
    font.setUnderline(true);
    controls.Link->setFont(font);
    connect(controls.Link, &QToolButton::clicked, this, [&controls] {
      if (const auto act = controls.Act) {
        act();
      }
    });
  }
  return controls;
}

void StatusLine::Show(const std::vector<Entry>& entries) {
  std::set<QString> shown;
  for (const Entry& entry : entries) {
    if (!entry.Text.isEmpty()) {
      shown.insert(entry.Name);
    }
    Controls& controls = ControlsOf(entry.Name);
    // In the order of this call, whenever the control was made.
    for (QWidget* control : std::initializer_list<QWidget*>{controls.Plain, controls.Link}) {
      flow_->removeWidget(control);
      flow_->addWidget(control);
      flow_->Join(*control, entry.Joins);
    }
  }
  for (auto& [name, controls] : controls_) {
    if (!shown.contains(name)) {
      Hide(controls);
    }
  }
  for (const Entry& entry : entries) {
    if (!entry.Text.isEmpty()) {
      Show(entry, ControlsOf(entry.Name));
    }
  }
}

void StatusLine::Show(const Entry& entry, Controls& controls) {
  const bool isLink = static_cast<bool>(entry.Act);
  QWidget* control = controls.Plain;
  if (isLink) {
    control = controls.Link;
    controls.Link->setText(QString(entry.Text).replace(u'&', QStringLiteral("&&")));  // no Alt letter
    controls.Link->setAccessibleName(entry.Text);
    controls.Link->setToolTip(entry.Text + u'\n' + entry.Tip);
    controls.Plain->clear();
  } else {
    controls.Plain->setText(entry.Text);
    controls.Plain->setToolTip(entry.Text);
    controls.Link->setText({});
  }
  controls.Plain->setVisible(!isLink);
  controls.Link->setVisible(isLink);
  controls.Act = entry.Act;
  if (entry.Text != controls.Text) {
    controls.Text = entry.Text;
    Announce(*control);
  }
}

void StatusLine::Hide(Controls& controls) {
  controls.Plain->clear();
  controls.Plain->hide();
  controls.Link->setText({});
  controls.Link->hide();
  controls.Act = nullptr;
  controls.Text.clear();
}
