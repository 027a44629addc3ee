#pragma once

#include <QObject>
#include <functional>
#include <memory>
#include <optional>
#include <string>

#include "audience/AudienceScreens.h"
#include "audience/AudienceStage.h"
#include "audience/AudienceWindow.h"
#include "core/data/IniReader.h"
#include "core/game/GuestList.h"
#include "platform/Files.h"
#include "platform/WakeLock.h"

/// The audience board from the operator's side: on and off, on which screen, and what it shows. A board that
/// is on belongs to its screen: it goes with it and comes back with it.
class AudienceBoard : public QObject {
  Q_OBJECT

 public:
  /// All must outlive the board; the session must be open.
  struct Parts {
    ::Session& Session;
    GuestList& Guests;
    const StringTable& Strings;
    IniReader& Ini;       ///< settings
    IniReader& StateIni;  ///< where the board was
    WakeLock& Awake;
    Files& Disk;
    QWidget& Operator;  ///< the main window, whose screen is never covered
    /// The name to show for a holder; empty for the gun.
    std::function<std::string(const NameHolder&)> NameShown;
  };

  explicit AudienceBoard(const Parts& parts);

  bool IsOn() const { return isOn_; }
  void Toggle();
  /// Switches it on if it was on when the program ended, without taking the keyboard.
  void Reopen();
  /// The program ends: the board goes, and is remembered as it was.
  void End();

  /// Name of the screen that the board waits for; empty if it waits for none.
  std::string AwaitedScreen() const;

  /// Shows the game on the operator's board, and switches the audience's on.
  void ShowResults();

  void SetGuests(GuestList::Names names);

  /// Other names are to be shown, whichever game is on the board: names were hidden or shown again, or
  /// members were changed.
  void ShowOtherNames();

  const AudienceSetup& Setup() const { return setup_; }
  /// Writes what has changed, and shows it.
  void SetSetup(const AudienceSetup& setup);

  AudienceState& State() { return state_; }
  AudienceStage& Stage() { return stage_; }

 signals:
  /// The board was switched, or begins or ends to wait for its screen.
  void Switched();

  /// It shows something else.
  void Changed();

 private:
  AudienceResults Results() const;
  void Hear(SessionChange change);
  void TurnOn(bool takesFocus);
  void TurnOff();
  /// Puts the board where it belongs; `gone` is a screen that is about to go.
  void PlaceWindow(bool takesFocus, const QScreen* gone = nullptr);
  void CoverScreen(const std::string& name);
  void OpenWindow(bool takesFocus);
  void MakeWindow(QScreen* wholeScreen);
  void Hide();
  void ShowSetup();
  void Watch(QScreen& screen);
  /// The main window has come to another screen: it is not covered there, and what it leaves is free.
  void FollowOperator();
  void HearScreens(const QScreen* gone = nullptr);
  std::vector<AudienceScreen> Screens(const QScreen* gone) const;
  void Remember(bool isOn);

  const Parts parts_;
  AudienceSetup setup_;
  AudienceState state_;
  AudienceStage stage_;
  bool isOn_ = false;
  AudienceSpot spot_;
  std::unique_ptr<AudienceWindow> window_;  ///< while it is shown
  std::optional<StayAwake> awake_;
  Subscription subscription_;
};
