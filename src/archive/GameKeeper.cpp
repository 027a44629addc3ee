#include "archive/GameKeeper.h"

#include <algorithm>
#include <utility>

#include "archive/ArchiveQueries.h"
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

/// Throws what keeping a game would throw, and changes nothing. A group of writes alone does not tell: the
/// journal beside the file is made by the first write in it.
void TryToWrite(Database& archive) {
  const WriteScope scope(archive);  // which ends without a commit
  archive.Statements().Change("INSERT INTO ArchiveKey (KeyID, Secret) VALUES (0, '')", {});
}

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
      EndLoading();
      break;
    case SessionChange::Saved:
      inFile_ = UncommittedInputs(parts_.Session.Game());
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
  loading_.reset();
  read_.reset();
  inFile_.reset();
  fileTime_.clear();
  lastStateIsElse_ = false;
  forgotten_ = {};
  // A game that is cleared in the middle of a pull goes on with the guns that are still to come.
}

void GameKeeper::BeginPull(GameSource source) {
  Keep();
  if (!parts_.Session.Game().DataPresent) {
    source_ = source;
  }
  pullBegun_ = true;
  scoresPending_ = true;
}

void GameKeeper::Try(const std::function<void()>& action) {
  if (ended_ || keeping_) {
    return;
  }
  const Flagged keeping(keeping_);
  // An action may only read, or find nothing to do.
  const auto act = [&] {
    action();
    if (!state_.Failure.empty()) {
      CheckRoom();
      TryToWrite(OpenFile());
    }
  };
  try {
    try {
      act();
    } catch (const RuntimeError& failure) {
      if (!SetAside(failure)) {
        throw;
      }
      act();
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
    Try([] {});
  }
}

void GameKeeper::Keep() {
  if (ended_ || keeping_) {
    return;
  }
  EndLoading();
  LeaveMovedFile();
  if (!parts_.Session.Game().DataPresent) {
    SeeWhetherItWorksAgain();
    return;
  }
  if (membersUnchecked_) {
    Try([this] { CheckUnchecked(); });
  }
  if (!membersUnchecked_) {
    const std::optional<Game> copy = CopyToKeep();
    KeepAs(copy ? *copy : parts_.Session.Game());
  }
}

std::optional<Game> GameKeeper::CopyToKeep() {
  if (!scoresPending_ && forgotten_.AreNone()) {
    return std::nullopt;
  }
  Game copy = parts_.Session.Game();
  if (scoresPending_) {  // the board shows the guns that came in when the pull is over, not before
    try {
      copy = parts_.Session.ScoredCopy();
    } catch (const RuntimeError&) {
      // Then the game is kept with the figures that it has.
    }
  }
  forgotten_.TakeFrom(copy);
  return copy;
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
  CheckSpaceForGames(parts_.Disk, parts_.UserDataFolder, parts_.Strings);
}

void GameKeeper::Write(const Game& game, const Marks& now) {
  CheckRoom();
  GameArchive archive = Archive();
  const int pulls = pulls_ + (pullBegun_ && (!kept_ || kept_->Raw != now.Raw) ? 1 : 0);
  const bool isLoaded = source_ == GameSource::File && pulls == 0;
  // A loaded game that is there already keeps the figures of its evening.
  const bool isThere = Recognise(archive, game, isLoaded);
  if (!isThere) {
    if (!gameId_ || !archive.KeepAgain(*gameId_, StateOf(game, pulls), FormerOf(now, game))) {
      formerPulls_ = 0;
      gameId_ = archive.Keep(StateOf(game, pulls));
    }
    lastStateIsElse_ = false;
  }
  played_ = archive.PlayedOf(*gameId_);
  if (inFile_ != UncommittedInputs(game)) {
    inFile_.reset();
  }
  kept_ = now;
  pulls_ = pulls;
  pullBegun_ = false;
  state_.KeptAt = parts_.Time.ShortTime();
}

// Guns that come in one by one complete a game; only what is added up hides what was there before.
FormerState GameKeeper::FormerOf(const Marks& now, const Game& game) const {
  if (lastStateIsElse_ || (inFile_ && inFile_ != UncommittedInputs(game))) {
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

std::uint64_t GameKeeper::UncommittedInputs(const Game& game) const {
  constexpr bool commits = false;
  return InputsDigest(game, parts_.Session.Missions().Text(), commits);
}

GameState GameKeeper::StateOf(const Game& game, int pulls) const {
  return {.Game = game,
          .Mission = parts_.Session.Missions().Text(),
          .Played = Played(game),
          .Source = source_,
          .Pulls = std::max(1, formerPulls_ + pulls),
          .Factors = parts_.Session.Factors()};
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
  membersUnchecked_ = membersUnchecked_ || check_;
  check_.reset();
  file_.Open.reset();
}

GameArchive GameKeeper::Archive() {
  return {OpenFile(), parts_.Session.DbMembers(), parts_.Strings};
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
