#pragma once

#include <QObject>
#include <functional>
#include <map>
#include <optional>
#include <string>
#include <vector>

#include "platform/MessageBoxes.h"

class Commands;
class QAbstractButton;
class QWidget;

/// The box about an invalid entry.
struct EntryFault {
  std::string Text;
  std::string Title = DefaultBoxTitle;
  BoxIcon Icon = BoxIcon::Critical;
};

/// The checks that a window makes when the focus leaves its entries. A failed one shows its box, puts the
/// focus back with all text selected, and stops the command of the button that took the focus. Nothing is
/// checked when another window or a popup comes to the front, nor when the window closes.
class EntryChecks : public QObject {
 public:
  /// Returns what is wrong with an entry, if anything. A RuntimeError from it is reported and stops the
  /// command too, but the focus is not put back.
  using Check = std::function<std::optional<EntryFault>()>;

  /// `commands` are those of the same window. Sets their `EntriesHold`.
  EntryChecks(Commands& commands, MessageBoxes& boxes);

  void Add(QWidget& entry, Check check);

  /// Entries may be left for this button without a check: it never checks (Cancel, Close), or does so itself.
  void LeaveFreelyFor(const QAbstractButton& button);

  /// Checks `entry` now, wherever the focus is. Returns false if the check failed, after its box. Throws
  /// RuntimeError if the check does.
  bool Holds(QWidget& entry);

 protected:
  bool eventFilter(QObject* watched, QEvent* event) override;

 private:
  bool IsLeft(const QEvent& focusOut) const;
  /// Makes the pending checks of all entries left. Returns false if one failed or a check is still running.
  bool CheckLeft();

  Commands& commands_;
  MessageBoxes& boxes_;
  std::map<QObject*, Check> checks_;
  std::vector<const QAbstractButton*> freeButtons_;
  std::vector<QWidget*> left_;  ///< entries whose check is pending, in the order they were left
  bool checking_ = false;
  bool returning_ = false;  ///< the focus is on its way back to an entry
};
