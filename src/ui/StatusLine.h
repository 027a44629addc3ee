#pragma once

#include <QFrame>
#include <functional>
#include <map>
#include <vector>

class FlowLayout;
class QLabel;
class QToolButton;

/// A line of short texts at the foot of a window, each of them plain or a link that does something about it.
/// A text that is new or has changed is announced to screen readers. A text that is too long for the line is
/// cut, with the whole in its tip.
class StatusLine : public QFrame {
 public:
  struct Entry {
    QString Name;  ///< of its control: `Name` as a label, `Name` + "Link" as a link
    QString Text;
    std::function<void()> Act = {};  ///< for a link
    QString Tip = {};                ///< what the link does
    bool Joins = false;              ///< belongs to the entry before
  };

  explicit StatusLine(QWidget* parent = nullptr);

  /// Shows these entries, in this order; one without a text is left out.
  void Show(const std::vector<Entry>& entries);

 private:
  struct Controls {
    QLabel* Plain = nullptr;
    QToolButton* Link = nullptr;
    std::function<void()> Act;
    QString Text;  ///< as shown; empty if it is not
  };

  Controls& ControlsOf(const QString& name);
  void Show(const Entry& entry, Controls& controls);
  static void Hide(Controls& controls);

  FlowLayout* flow_;
  std::map<QString, Controls> controls_;  ///< never destroyed: a link may be on the stack
};
