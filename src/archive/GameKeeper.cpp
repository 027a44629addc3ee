#include "archive/GameKeeper.h"

#include <algorithm>
#include <utility>

#include "archive/ArchiveQueries.h"
#include "archive/DeletedGames.h"
#include "archive/FigureDigests.h"
#include "archive/KeepingFailure.h"
#include "platform/RuntimeError.h"

namespace {

/// True as long as it exists.
class Flagged {
 public:
  explicit Flagged(bool& flag) : flag_(flag) { flag_ = true; }
  ~Flagged() { flag_ = false; }
  Flagged(const Flagged&) = delete;
  Flagged& operator=(const Flagged&) = delete;

 private:
  bool& flag_;
};

}  // namespace

GameKeeper::GameKeeper(Parts parts)
    : parts_(std::move(parts)),
      guests_(parts_.Guests),
      copy_({parts_.Disk, parts_.Time, parts_.Strings, parts_.UserDataFolder}),
      subscription_(parts_.Session.Listen([this](SessionChange change) { Hear(change); })) {
  parts_.Session.BeforeClear = [this] { Keep(); };
}

GameKeeper::~GameKeeper() {
  CloseFile();
  parts_.Session.BeforeClear = nullptr;
}

void GameKeeper::Hear(SessionChange change) {
  switch (change) {
    case SessionChange::Cleared:
      Forget();
      break;
    case SessionChange::Loaded:
      source_ = GameSource::File;
      pullBegun_ = false;  // whatever a pull before it was to bring
      break;
    case SessionChange::Scores:
      scoresPending_ = false;
      EndOpening();
      break;
    default:
      break;
  }
}

void GameKeeper::Forget() {
  gameId_.reset();
  kept_.reset();
  guests_.Forget();
  state_.KeptAt.clear();
  source_ = GameSource::Cable;
  pulls_ = 0;
  formerPulls_ = 0;
  opening_.reset();
  lastStateIsElse_ = false;
  // A game that is cleared in the middle of a pull goes on with the guns that are still to come.
}

void GameKeeper::Open(std::int64_t gameId, std::int64_t state, const Game& game,
                      const std::string& missionName) {
  gameId_ = gameId;
  lastStateIsElse_ = state != 0;
  opening_ = InputsDigest(game, missionName);
  Try([this] {
    played_ = PlayedIn(OpenFile().Statements(), *gameId_);
    NotePulls();
  });
}

void GameKeeper::EndOpening() {
  if (!opening_) {
    return;
  }
  // A mission that is gone, or a button that has an owner now, make other inputs of it without the operator.
  const Marks now = MarksOf(parts_.Session.Game());
  lastStateIsElse_ = lastStateIsElse_ || now.Inputs != *opening_;
  kept_ = now;
  opening_.reset();
  state_.KeptAt = parts_.Time.ShortTime();
}

void GameKeeper::BeginPull(GameSource source) {
  opening_.reset();
  Keep();
  if (!parts_.Session.Game().DataPresent) {
    source_ = source;
  }
  pullBegun_ = true;
  scoresPending_ = true;
}

template <typename Action>
void GameKeeper::Try(const Action& action) {
  if (ended_ || keeping_) {
    return;
  }
  const Flagged keeping(keeping_);
  try {
    try {
      action();
    } catch (const RuntimeError& failure) {
      if (!SetAside(failure)) {
        throw;
      }
      action();
    }
    state_.Failure.clear();
  } catch (const RuntimeError& failure) {
    state_.Failure = TextOf(failure);
    CloseFile();  // another mode, or another file, may do next time
  }
}

bool GameKeeper::SetAside(const RuntimeError& failure) {
  const std::string path = file_.Path;
  if (failure.Number() != Fault::UnrecognizedDatabase || !file_.Open || !IsAboutFile(failure, path)) {
    return false;
  }
  CloseFile();
  return SetArchiveAside(parts_.Disk, path);
}

std::string GameKeeper::TextOf(const RuntimeError& failure) const {
  for (const char* name : {"/games.mdb", "/games-new.mdb"}) {
    if (const std::string path = parts_.UserDataFolder + name; IsAboutFile(failure, path)) {
      return KeepingFailureText(failure, path, parts_.Strings);
    }
  }
  return failure.what();
}

void GameKeeper::SeeWhetherItWorksAgain() {
  if (!state_.Failure.empty()) {
    Try([this] {
      CheckRoom();
      const WriteScope scope(OpenFile());  // which nothing is written in
    });
  }
}

void GameKeeper::Keep() {
  if (ended_ || keeping_ || opening_) {
    return;
  }
  LeaveMovedFile();
  if (!parts_.Session.Game().DataPresent) {
    SeeWhetherItWorksAgain();
    return;
  }
  if (!scoresPending_) {
    KeepAs(parts_.Session.Game());
    return;
  }
  // The board shows the guns that came in when the pull is over, not before.
  Game copy = parts_.Session.Game();
  try {
    copy = parts_.Session.ScoredCopy();
  } catch (const RuntimeError&) {
    // Then the game is kept with the figures that it has.
  }
  KeepAs(copy);
}

void GameKeeper::KeepAs(const Game& game) {
  const Marks now = MarksOf(game);
  if (!IsKept(now)) {
    Try([&] { Write(game, now); });
  } else {
    SeeWhetherItWorksAgain();
  }
  if (gameId_ && kept_ && state_.Failure.empty() && guests_.HaveChanged(*gameId_)) {
    Try([this] { KeepGuests(); });
  }
}

void GameKeeper::KeepGuests() {
  CheckRoom();
  Database& archive = OpenFile();
  if (PlayedIn(archive.Statements(), *gameId_) == played_) {  // else the archive has become another one
    guests_.Keep(archive, *gameId_);
  }
}

GameKeeper::Marks GameKeeper::MarksOf(const Game& game) const {
  Marks marks{.Inputs = InputsDigest(game, parts_.Session.Missions().Text()),
              .Figures = FiguresDigest(game),
              .Raw = {}};
  for (int index = 1; index <= PlayerCount; ++index) {
    if (const Player& player = game.Players(index); player.Active) {
      marks.Raw[static_cast<std::size_t>(index - 1)] = RawDigest(player);
    }
  }
  return marks;
}

// Other factors of today are no reason to give an old game other figures.
bool GameKeeper::IsKept(const Marks& now) const {
  return kept_ && kept_->Inputs == now.Inputs && (pulls_ == 0 || kept_->Figures == now.Figures);
}

void GameKeeper::CheckRoom() const {
  if (parts_.Disk.FreeSpace(parts_.UserDataFolder) < LeastFreeSpace) {
    throw RuntimeError(Fault::DiskFull, parts_.Strings.Text(OwnText::KeeperDiskFull));
  }
}

bool GameKeeper::Recognise(GameArchive& archive, const Game& game, bool isLoaded) {
  const bool isLost = gameId_ && PlayedIn(file_.Open->Statements(), *gameId_) != played_;
  if (isLost) {
    gameId_.reset();
  }
  if (!isLost && !(isLoaded && !kept_)) {
    return false;
  }
  const auto found = archive.FindState(game, parts_.Session.Missions().Text());
  if (!found) {
    return false;
  }
  gameId_ = found->GameId;
  lastStateIsElse_ = found->State != 0;
  if (isLoaded) {
    NotePulls();
  }
  return isLoaded;
}

void GameKeeper::Write(const Game& game, const Marks& now) {
  CheckRoom();
  CheckUnchecked();
  GameArchive archive = Archive();
  const int pulls = pulls_ + (pullBegun_ && (!kept_ || kept_->Raw != now.Raw) ? 1 : 0);
  const bool isLoaded = source_ == GameSource::File && pulls == 0;
  // A loaded game that is there already keeps the figures of its evening.
  const bool isThere = Recognise(archive, game, isLoaded);
  if (!isThere) {
    if (!gameId_ || !archive.KeepAgain(*gameId_, StateOf(game, pulls), FormerOf(now))) {
      formerPulls_ = 0;
      gameId_ = archive.Keep(StateOf(game, pulls));
    }
    lastStateIsElse_ = false;
  }
  played_ = PlayedIn(file_.Open->Statements(), *gameId_);
  kept_ = now;
  pulls_ = pulls;
  pullBegun_ = false;
  state_.KeptAt = parts_.Time.ShortTime();
}

void GameKeeper::NotePulls() {
  const std::optional<ListedGame> row = ArchiveQueries(file_.Open->Statements()).Game(*gameId_);
  formerPulls_ = row ? row->Pulls : 0;
}

// Guns that come in one by one complete a game; only what is added up hides what was there before.
FormerState GameKeeper::FormerOf(const Marks& now) const {
  if (lastStateIsElse_) {
    return FormerState::KeptToo;
  }
  if (!kept_ || kept_->Raw == now.Raw) {
    return FormerState::Replaced;
  }
  bool addedUp = pullBegun_;
  for (std::size_t i = 0; i < now.Raw.size(); ++i) {
    addedUp = addedUp || (kept_->Raw[i] != 0 && kept_->Raw[i] != now.Raw[i]);
  }
  return addedUp ? FormerState::KeptToo : FormerState::Replaced;
}

GameState GameKeeper::StateOf(const Game& game, int pulls) const {
  return {.Game = game,
          .Mission = parts_.Session.Missions().Text(),
          .Played = Played(),
          .Source = source_,
          .Pulls = std::max(1, formerPulls_ + pulls),
          .Factors = parts_.Session.Factors()};
}

std::string GameKeeper::Played() const {
  const std::string told =
      source_ == GameSource::File ? parts_.Time.Stamp(parts_.Session.Game().GameDate) : std::string();
  return told.empty() ? parts_.Progress.Received() : told;
}

Database& GameKeeper::OpenFile() {
  LeaveMovedFile();
  if (!file_.Open) {
    file_ = OpenArchive(parts_.Engine, parts_.Disk, parts_.UserDataFolder,
                        parts_.ProgramFolder + "/games_default.mdb");
    state_.Unusable = file_.Unusable;
  }
  return *file_.Open;
}

void GameKeeper::LeaveMovedFile() {
  if (file_.Open && file_.Open->HasMoved()) {
    CloseFile();
    kept_.reset();
  }
}

void GameKeeper::CloseFile() noexcept {
  copy_.Stop();
  file_.Open.reset();
}

GameArchive GameKeeper::Archive() {
  return {OpenFile(), parts_.Session.DbMembers(), parts_.Strings};
}

void GameKeeper::CheckMembers() {
  membersUnchecked_ = true;
  Try([this] { CheckUnchecked(); });
}

void GameKeeper::CheckUnchecked() {
  if (membersUnchecked_ && ArchiveExists(parts_.Disk, parts_.UserDataFolder)) {
    for (const CutMember& cut : Archive().CheckMembers()) {
      state_.CutGames += cut.Games;
    }
  }
  membersUnchecked_ = false;
}

void GameKeeper::RemoveDeleted() {
  Try([this] {
    if (ArchiveExists(parts_.Disk, parts_.UserDataFolder)) {
      Archive().RemoveDeleted(LastTimeOfRemoved(parts_.Time.Now()));
    }
  });
}

void GameKeeper::NoteMembers() {
  Try([this] {
    CheckUnchecked();
    if (file_.Open) {
      Archive().Known().NoteChanges();
    }
  });
}

bool GameKeeper::CopyAPart() {
  if (ended_ || keeping_) {
    return false;
  }
  try {
    if (!copy_.IsRunning() && (!ArchiveExists(parts_.Disk, parts_.UserDataFolder) || !copy_.IsDue())) {
      state_.CopyFailure.clear();
      return false;
    }
    const bool isWhole = copy_.Step(OpenFile());
    if (isWhole) {
      state_.CopyFailure.clear();
    }
    return !isWhole;
  } catch (const RuntimeError& failure) {
    state_.CopyFailure = TextOf(failure);
    return false;
  }
}

void GameKeeper::End() {
  Keep();
  ended_ = true;
  subscription_.End();
  CloseFile();
}
