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

/// What a command does when it is given while another command of its window is on the stack.
enum class WhileBusy {
  Run,    ///< on top of the other one
  Ignore  ///< nothing
};

/// The commands of one window. A failure in one is reported and ends it. Since a wait in a command processes
/// events, others can start on top of it; a window closed meanwhile goes away once the last has unwound.
///
/// The window owns this object and asks `MayClose` in its `closeEvent` (a dialog: in its `reject`).
class Commands : public QObject {
 public:
  /// `boxes` must outlive the window.
  Commands(QWidget& window, MessageBoxes& boxes);

  /// Called when the window is asked to close while commands run, to end their waits. May be called again.
  std::function<void()> EndWaits;

  /// Called each time the last command has unwound, before a delayed close.
  std::function<void()> AllUnwound;

  /// Called after an action's or a button's command, once no command is left on the stack.
  std::function<void()> AfterCommand;

  /// Asked before the command of a pressed button that has the focus; false stops the command. Not asked when
  /// a screen reader presses the button.
  std::function<bool()> EntriesHold;

  /// Runs one of the operator's commands. Returns false if it failed.
  bool Run(const std::function<void()>& command);

  void Connect(QAction& action, std::function<void()> command, WhileBusy whileBusy = WhileBusy::Run);

  /// However the button is pressed, it first gets the focus.
  void Connect(QAbstractButton& button, std::function<void()> command, WhileBusy whileBusy = WhileBusy::Run);

  /// Escape then does what this connected or plain button does, and nothing while a command runs. For a
  /// window without a Cancel button.
  void EscapePresses(QAbstractButton& button);

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

  /// True in a command that was given while another one is on the stack.
  bool Nested() const { return running_ > 1; }

  /// True once the window was asked to close while commands run; polling jobs check this.
  bool CloseRequested() const { return closeRequested_; }

  /// True if no command is running. Otherwise ends the waits; the window closes when the last command has
  /// unwound.
  bool MayClose();

  /// True while a button pressed by a screen reader takes the focus: the entry left is then not checked.
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
  /// Gives the button the focus. Returns false if the entry being left keeps it.
  bool TakeFocus(QAbstractButton& button);
  void PressByEscape();
  /// The connected button that Return would press now, if any.
  QAbstractButton* DefaultButton() const;

  QWidget& window_;
  MessageBoxes& boxes_;
  std::vector<QPointer<QAbstractButton>> buttons_;
  QPointer<QAbstractButton> escapeButton_;
  int running_ = 0;  ///< commands on the stack
  bool closeRequested_ = false;
  bool pressedUnfocused_ = false;
};
