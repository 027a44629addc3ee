#pragma once

#include <array>
#include <cstdint>
#include <functional>
#include <memory>
#include <optional>
#include <string>

#include "archive/ArchiveFile.h"
#include "archive/ArchiveRoom.h"
#include "archive/GameArchive.h"
#include "archive/GamePersons.h"
#include "archive/GuestRows.h"
#include "archive/MemberCheck.h"
#include "archive/WeeklyCopy.h"
#include "core/game/GameProgress.h"
#include "core/game/Session.h"
#include "platform/Clock.h"
#include "platform/Files.h"

/// What the operator is told about the keeping of games.
struct KeptState {
  std::string KeptAt;   ///< time of day at which the game on the board was last kept; empty if it is not kept
  std::string Failure;  ///< why games are not kept, and what to do about it; empty if nothing failed
  std::string
      Unusable;  ///< archive file that could not be used, so that another one was begun; empty if none
  std::string CopyFailure;  ///< why the archive's weekly copy is not made; empty if nothing failed
  int CutGames = 0;         ///< past games that no longer name a member whose number is somebody else's now

  bool operator==(const KeptState&) const = default;
};

/// Keeps the game on the board in the archive, without being asked and without asking. A failure stops
/// nothing: it is told, and the next call tries again with the archive as it is by then. An archive that
/// turns out damaged stays as it is from then on, and another one beside it takes its place.
class GameKeeper {
 public:
  struct Parts {
    ::Session& Session;
    const GameProgress& Progress;
    const Clock& Time;
    Files& Disk;
    DatabaseEngine& Engine;  ///< should not wait long for a locked file
    const StringTable& Strings;
    std::string UserDataFolder;
    std::string ProgramFolder;
    const GuestList* Guests = nullptr;  ///< names in the game on the board; null where nobody enters any
  };

  static constexpr std::uint64_t LeastFreeSpace = ::LeastFreeSpace;

  /// The session must be open. All parts must outlive this object.
  explicit GameKeeper(Parts parts);
  ~GameKeeper();
  GameKeeper(const GameKeeper&) = delete;
  GameKeeper& operator=(const GameKeeper&) = delete;

  /// Guns are about to be read into the board. What is kept of the game by then stays as a further file of
  /// it.
  void BeginPull(GameSource source);

  /// Keeps the game on the board if it is not kept as it is: if it has other inputs than what was kept or,
  /// where it was pulled, other figures. The archive's file is made when it is needed first. After a failure
  /// it looks whether games can be kept again, also without a game.
  void Keep();

  /// A game of the archive is being loaded: `game` as it was just read, with the mission of that name, its
  /// scores still to come. Whatever becomes of it is that game; a state that the operator changes then does
  /// not replace a later one. To be called once the session has cleared the board.
  void Open(std::int64_t gameId, std::int64_t state, const Game& game, const std::string& missionName);

  /// The game of a file is being loaded: `game` as it was just read, with the mission of that name, its
  /// scores still to come. `fileTime` is the local time, "YYYY-MM-DD HH:MM:SS", at which the file was last
  /// changed; empty if that is not known. If the archive has the game, whatever becomes of it is that game;
  /// loading alone changes nothing of it. To be called once the session has cleared the board.
  void Load(const Game& game, const std::string& missionName, const std::string& fileTime);

  /// Removes some of the games that were deleted so long ago that they cannot be brought back. Returns true
  /// if there may be more. Does nothing without an archive.
  bool RemoveDeleted();

  /// Finds the numbers of members that belong to somebody else now, and takes them from the players on the
  /// board; CutAPart then cuts them from past games. To be called at start, and when the members have been
  /// replaced as a whole. After a failure it is done before anything else is kept. Does nothing without an
  /// archive.
  void CheckMembers();

  /// Cuts them from some past games, in some 50 milliseconds. Returns true if there is more to do, and false
  /// after a failure: the next check begins anew then.
  bool CutAPart();
  /// How far that is, from 0 to 1.
  double CutDone() const { return check_ ? check_->Done() : 1; }

  /// The archive forgets these persons: while the present game is on the board, it is kept without them. The
  /// board keeps them.
  void ForgetPersons(const GamePersons& persons);

  /// Notes what now tells the known members apart. To be called after the operator may have changed members.
  void NoteMembers();

  /// Does a step of a few milliseconds of the archive's weekly copy, if that is due. Returns false if there
  /// is nothing more to do for now, also after a failure. To be called while nobody waits for the program.
  bool CopyAPart();

  /// The archive's file is about to be closed: from now on nothing is kept any more.
  void End();

  const KeptState& State() const { return state_; }

 private:
  using RawDigests = std::array<std::uint64_t, PlayerCount>;

  /// What tells one state of the game from the next.
  struct Marks {
    std::uint64_t Inputs = 0;
    std::uint64_t Figures = 0;
    RawDigests Raw{};  ///< of each active player's figures as the gun gave them; 0 for the others
  };

  /// A game as it was read, before its scores were calculated.
  struct ReadGame {
    ::Game Game;
    std::string Mission;
  };

  void Hear(SessionChange change);
  /// The scores of the game that is being loaded are there, or will not come.
  void EndLoading();
  void Forget();
  void KeepAs(const Game& game);
  Marks MarksOf(const Game& game) const;
  bool IsKept(const Marks& now) const;
  void Write(const Game& game, const Marks& now);
  /// Finds the loaded game in the archive, as it was read.
  void FindRead(GameArchive& archive);
  /// Finds the game on the board in the archive if that has become another one, or the game was loaded. True
  /// if a loaded game is there just as it is.
  bool Recognise(GameArchive& archive, const Game& game, bool isLoaded);
  /// Finds that game, and goes on with it. True if the archive has just the same.
  bool GoOnWith(GameArchive& archive, const Game& game, const std::string& missionName);
  /// Names of guests alone make no other state of the game, nor other figures.
  void KeepGuests();
  void NotePulls();
  FormerState FormerOf(const Marks& now, const Game& game) const;
  /// Digest of a game's inputs but for commits.
  std::uint64_t UncommittedInputs(const Game& game) const;
  GameState StateOf(const Game& game, int pulls) const;
  /// Local time at which the game was played, "YYYY-MM-DD HH:MM:SS".
  std::string Played(const Game& game) const;
  GameArchive Archive();
  Database& OpenFile();
  void CloseFile() noexcept;
  /// Closes the file if it is no longer the one at its path. What is in that one must be seen.
  void LeaveMovedFile();
  void CheckRoom() const;
  /// Begins to check the members if that is still to be done: noting those of today would make others of the
  /// known.
  void CheckUnchecked();
  void TakeFromBoard(const GamePersons& persons);
  MemberCheck::Parts CheckParts();
  /// The game on the board as it is to be kept, if that is not just as it is there.
  std::optional<Game> CopyToKeep();
  void SeeWhetherItWorksAgain();
  /// True if another archive takes the place of the one that failed so.
  bool SetAside(const RuntimeError& failure);
  /// Runs `action`, a second time if it can be done with another archive, and keeps what it throws as the
  /// failure to tell.
  void Try(const std::function<void()>& action);
  std::string TextOf(const RuntimeError& failure) const;

  const Parts parts_;
  ArchiveFile file_;
  KeptState state_;
  KeptGuests guests_;
  WeeklyCopy copy_;                     ///< of the open file
  std::optional<std::int64_t> gameId_;  ///< of the game on the board, once it is kept
  std::string played_;                  ///< in its row; no other archive has that number with that time
  std::optional<Marks> kept_;
  GameSource source_ = GameSource::Cable;
  int pulls_ = 0;
  int formerPulls_ = 0;  ///< of a past game, before it came onto the board again
  /// Digest of the inputs of a game that is being loaded, as they were before its scores were calculated.
  std::optional<std::uint64_t> loading_;
  std::optional<ReadGame> read_;  ///< the loaded game, until it has been looked for in the archive
  /// Digest of the last inputs that a file has, but for commits: the archive keeps these, to know the file.
  std::optional<std::uint64_t> inFile_;
  std::string fileTime_;          ///< when the file of the loaded game was last changed
  bool lastStateIsElse_ = false;  ///< what the archive has as the last state was not on this board
  bool pullBegun_ = false;        ///< and nothing of it is kept yet
  bool scoresPending_ = false;    ///< guns may have been read since the last calculation
  bool membersUnchecked_ = false;
  std::optional<MemberCheck> check_;  ///< of the open file, while past games are being cut
  GamePersons forgotten_;             ///< not to be kept as players of the game on the board
  bool keeping_ = false;
  bool ended_ = false;
  Subscription subscription_;
};
