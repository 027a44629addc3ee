#pragma once

#include <QObject>
#include <QTimer>
#include <cstdint>
#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "core/data/IniReader.h"
#include "core/game/GuestList.h"
#include "core/game/HiddenNames.h"
#include "core/game/Session.h"
#include "platform/Clock.h"
#include "platform/LocalAddresses.h"
#include "platform/MonotonicClock.h"
#include "platform/PipedProgram.h"
#include "web/EveningGames.h"
#include "web/PageProbe.h"
#include "web/PageServer.h"
#include "web/PageSetup.h"
#include "web/PublicRanking.h"

/// The results page from the operator's side: on and off, where it is, and what is on it. While it is off
/// there is neither a program nor a page nor a game of the evening. Once it is on, the evening's earlier
/// games come from those that were kept.
class ResultsHost : public QObject {
  Q_OBJECT

 public:
  /// A game as it was kept.
  struct KeptGame {
    const ::Game& Game;
    std::string Played;  ///< local time, "YYYY-MM-DD HH:MM:SS"
    GuestNames OfGuests = {};
  };

  /// The games that were kept, in this run of the program or an earlier one. Both may throw RuntimeError.
  struct KeptEvening {
    /// The numbers of those that were played since a local time "YYYY-MM-DD HH:MM:SS", the latest first.
    std::function<std::vector<std::int64_t>(const std::string& from)> Games;
    /// Hands one of them to `take`.
    std::function<void(std::int64_t number, const std::function<void(const KeptGame&)>& take)> Read;
  };

  /// All must outlive the host; the session must be open.
  struct Parts {
    ::Session& Session;
    const GuestList& Guests;
    HiddenNames& Hidden;
    const StringTable& Strings;
    IniReader& Ini;  ///< settings
    const Clock& Time;
    const MonotonicClock& Elapsed;
    const LocalAddresses& Addresses;
    std::function<std::unique_ptr<PipedProgram>()> MakeProgram;
    std::string Path;                      ///< of the program that serves the pages
    std::function<bool()> Pulling;         ///< the game on the board is not yet complete
    std::function<bool()> AwaitsBoard;     ///< the audience board is on, and does not show that game
    std::function<PublicRanking()> Ranks;  ///< of this month, all members; may throw RuntimeError
    KeptEvening Kept;
  };

  explicit ResultsHost(const Parts& parts);
  ~ResultsHost() override;

  /// Switches it on if that is set.
  void Begin();
  /// The program ends: the page goes, and is remembered as it was.
  void End();

  bool IsOn() const { return running_ != nullptr; }

  /// True while the earlier games of the evening are still being read, one after the other. The game on the
  /// board comes behind them.
  bool IsReading() const;

  const PageSetup& Setup() const { return setup_; }
  /// Writes what has changed, and does it.
  void SetSetup(const PageSetup& setup);

  /// The name that the audience board shows for a holder; empty for the gun.
  std::string NameOnBoard(const NameHolder& holder) const;
  /// The same for the pages.
  std::string NameOnPage(const NameHolder& holder) const;

  /// Other names are hidden or given than before.
  void ShowOtherNames();
  /// The audience board shows something else.
  void Follow();

  /// Looks at addresses, answers and ages; also done by itself every few seconds while it is on.
  void Look();

  PageServing Serving() const;
  /// The address at which it is served, or will be; empty without one.
  std::string Address() const;
  /// What phones are to open; empty unless the program itself gets an answer there.
  std::string Url() const;

 signals:
  /// One of the above is different.
  void Changed();

  /// The setting of the names is another one.
  void NamesChanged();

 private:
  /// What there is while the page is on.
  struct Running;

  struct Moment {
    std::chrono::microseconds Since;
    std::string Text;  ///< time of day
  };

  void TurnOn();
  void TurnOff();
  void Hear(SessionChange change);
  void HearServer();
  void NameAnew();
  void ReadEarlier();
  void ListEarlier();
  void TakeEarlier(std::int64_t number);
  void TakeGame();
  /// Puts the game on the board onto the pages, once it may appear.
  void Publish(bool hasChanged);
  void Put(const EveningGame& game);
  void PutAll();
  void PutRanking();
  void ServeWhereItBelongs();
  void ServeAt(const std::string& address);
  /// That local time "YYYY-MM-DD HH:MM:SS"; none if it is not of this evening.
  std::optional<Moment> ThisEvening(const std::string& stamp) const;
  /// When the game on the board was played; none for one from a file that is not of this evening.
  std::optional<Moment> Played() const;

  const Parts parts_;
  PageSetup setup_;
  std::unique_ptr<Running> running_;  ///< null while off
  bool isLoaded_ = false;             ///< the game on the board is from a file
  bool isScored_ = false;             ///< since it was cleared or loaded
  Subscription subscription_;
};
