#pragma once

#include <functional>
#include <string>

#include "audience/AudienceResults.h"

/// What the board for the audience shows.
enum class AudienceView {
  Idle,      ///< the venue's name and picture
  Incoming,  ///< scores are coming in
  Results,   ///< pages of a game
  Phone,     ///< where one's own score can be looked up
  Blank,     ///< nothing
};

/// What the board shows, and when it changes. Results stay until the operator changes them, whatever happens
/// to the game on the operator's board; a pull, once scored, can change them by itself. Blank stays until the
/// operator ends it.
class AudienceState {
 public:
  /// `results` makes those of the game on the operator's board; empty ones if there is no game. `changed` is
  /// called after each change of what is shown.
  AudienceState(std::function<AudienceResults()> results, std::function<void()> changed);

  /// Nothing is made for a board that is off; once it is on, it shows what it would show by then.
  void TurnOn();
  void TurnOff() { isOn_ = false; }

  /// True if results of a pull are shown by themselves.
  void SetFollows(bool follows) { follows_ = follows; }

  /// Where players find their own score; empty if nowhere.
  void SetAddress(const std::string& address);
  const std::string& Address() const { return address_; }

  /// A pull begins, at the latest with its first count; then `received` of `expected` guns have come in; then
  /// it ends, with guns or without.
  void BeginPull();
  void TellReceived(int received, int expected);
  void EndPull(bool withGuns);
  /// The game on the operator's board was cleared, or another one is being loaded.
  void ForgetGame();
  /// Its scores were calculated.
  void TellScored();

  /// Changes what stands in the results that are shown, whichever game they are of.
  void ChangeResults(const std::function<void(AudienceResults&)>& change);

  /// True while the results of the game on the operator's board are there to be seen.
  bool ShowsGameOfBoard() const { return isOn_ && isShown_ && View() == AudienceView::Results; }

  // What the operator chooses. Without a game ShowResults does nothing, and during a pull it shows the last
  // results.
  void ShowResults();
  void ShowIdle();
  void ShowBlank();

  /// Never Phone, which takes turns with the pages of the results.
  AudienceView View() const;
  const AudienceResults& Results() const { return shown_; }
  int Received() const { return received_; }
  int Expected() const { return expected_; }

 private:
  void Take();
  /// Tells of another view, or of another content of the same one.
  void Tell(bool isNew);

  const std::function<AudienceResults()> make_;
  const std::function<void()> changed_;
  std::string address_;
  AudienceResults shown_;
  AudienceView chosen_ = AudienceView::Idle;  ///< Idle, Results or Blank
  AudienceView told_ = AudienceView::Idle;
  bool isOn_ = false;
  bool follows_ = false;
  bool pulling_ = false;
  bool isAwaited_ = false;  ///< guns came in, and the figures shown by themselves are not made yet
  bool isPulled_ = false;   ///< the game on the operator's board was pulled, and its scores are to be shown
  bool isShown_ = false;    ///< the game on the operator's board is the one that is shown
  int received_ = 0;
  int expected_ = 0;
};

/// What stands on the board at one turn.
struct AudienceTurn {
  AudienceView View = AudienceView::Idle;
  int Page = 0;  ///< of the results, counted from 0
};

/// The turn of this number, counted from 0, of results with so many pages: page after page, and where there
/// is an address, that at every fourth turn.
AudienceTurn TurnOf(int number, int pages, bool hasAddress);

/// How many turns there are before they repeat; 1 if nothing ever changes.
int TurnCount(int pages, bool hasAddress);
