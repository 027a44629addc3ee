#pragma once

#include <QObject>
#include <QPointer>
#include <functional>
#include <initializer_list>
#include <type_traits>
#include <utility>
#include <vector>

#include "platform/MessageBoxes.h"

class QAbstractButton;
class QAction;
class QWidget;

/// What a command does when it is pressed while another one of its window is on the stack.
enum class WhileBusy {
  Run,    ///< on top of the other one
  Ignore  ///< nothing
};

/// The commands of one window. A failure in one is reported and ends it. Since a wait in a command serves
/// events, others can start on top of it; a window that is closed meanwhile goes once the last has unwound.
///
/// The window owns this object and asks `MayClose` in its `closeEvent` (a dialog: in its `reject`).
class Commands : public QObject {
 public:
  /// `boxes` must outlive the window.
  Commands(QWidget& window, MessageBoxes& boxes);

  /// Called when the window is to close while commands run, to end their waits. May be called again.
  std::function<void()> EndWaits;

  /// Called each time when the last command has unwound, before a late close.
  std::function<void()> AllUnwound;

  /// Asked before the command of a button that was pressed, when the button has the focus; false stops the
  /// command. A press through a screen reader is not asked about.
  std::function<bool()> EntriesHold;

  /// Runs a command of the operator. Returns false when it failed.
  bool Run(const std::function<void()>& command);

  void Connect(QAction& action, std::function<void()> command, WhileBusy whileBusy = WhileBusy::Run);

  /// A press of the button by any means gives it the focus first.
  void Connect(QAbstractButton& button, std::function<void()> command, WhileBusy whileBusy = WhileBusy::Run);

  /// Actions or buttons with the member functions that they run.
  template <typename Control, typename Owner>
  using Table = std::initializer_list<std::pair<Control*, void (std::type_identity_t<Owner>::*)()>>;

  template <typename Owner>
  void Connect(Owner& owner, Table<QAction, Owner> commands) {
    ConnectEach(owner, commands);
  }
  template <typename Owner>
  void Connect(Owner& owner, Table<QAbstractButton, Owner> commands) {
    ConnectEach(owner, commands);
  }

  /// True while a command is on the stack.
  bool Running() const { return running_ > 0; }

  /// True once the window was to close while commands ran; jobs that poll look here.
  bool CloseRequested() const { return closeRequested_; }

  /// True when nothing runs. Else the waits are ended, and the window is closed when the last command has
  /// unwound.
  bool MayClose();

  /// True while a button takes the focus that a screen reader pressed: entries are left unchecked then.
  bool PressedUnfocused() const { return pressedUnfocused_; }

  QWidget& Window() const { return window_; }

 protected:
  bool eventFilter(QObject* watched, QEvent* event) override;

 private:
  template <typename Owner, typename Entries>
  void ConnectEach(Owner& owner, const Entries& commands) {
    for (const auto& [control, command] : commands) {
      Connect(*control, [&owner, command = command] { (owner.*command)(); });
    }
  }
  void Start(const QObject& control, const std::function<void()>& command, WhileBusy whileBusy);
  void Press(QAbstractButton& button, const std::function<void()>& command, WhileBusy whileBusy);
  /// Gives the button the focus. Returns false when an entry that is left thereby keeps it.
  bool TakeFocus(QAbstractButton& button);
  /// The button of this table that Return presses now, if any.
  QAbstractButton* DefaultButton() const;

  QWidget& window_;
  MessageBoxes& boxes_;
  std::vector<QPointer<QAbstractButton>> buttons_;
  int running_ = 0;  ///< commands on the stack
  bool closeRequested_ = false;
  bool pressedUnfocused_ = false;
};
