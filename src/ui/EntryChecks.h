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

/// The box about an entry that cannot stay as it is.
struct EntryFault {
  std::string Text;
  std::string Title = DefaultBoxTitle;
  BoxIcon Icon = BoxIcon::Critical;
};

/// The checks that a window makes when its entries are left. A failed one shows its box, puts the focus back
/// with all selected, and stops the command of the button for which the entry was left. Nothing is checked
/// when another window or a popup comes to the front, nor when the window goes.
class EntryChecks : public QObject {
 public:
  /// What is wrong with an entry, if anything. One that throws RuntimeError is reported and stops a command,
  /// too, but the focus stays where it went.
  using Check = std::function<std::optional<EntryFault>()>;

  /// `commands` are those of the same window. Takes over their `EntriesHold`.
  EntryChecks(Commands& commands, MessageBoxes& boxes);

  void Add(QWidget& entry, Check check);

  /// An entry may be left for this button without a check: one that never checks (Cancel, Close), or that
  /// checks by itself.
  void LeaveFreelyFor(const QAbstractButton& button);

  /// Makes the check of `entry` now, wherever the focus is. Returns false after its box. Throws RuntimeError
  /// when the check does.
  bool Holds(QWidget& entry);

 protected:
  bool eventFilter(QObject* watched, QEvent* event) override;

 private:
  bool IsLeft(const QEvent& focusOut) const;
  /// Makes the checks of all entries that were left. Returns false when one failed or is still being made.
  bool CheckLeft();

  Commands& commands_;
  MessageBoxes& boxes_;
  std::map<QObject*, Check> checks_;
  std::vector<const QAbstractButton*> freeButtons_;
  std::vector<QWidget*> left_;  ///< entries whose check is still to be made, in the order they were left
  bool checking_ = false;
  bool returning_ = false;  ///< the focus is on its way back to an entry
};
