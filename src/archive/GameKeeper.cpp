#include "archive/GameKeeper.h"

#include <algorithm>
#include <utility>

#include "archive/ArchiveQueries.h"
#include "archive/DeletedGames.h"
#include "core/game/WordDigest.h"
#include "platform/RuntimeError.h"

namespace {

std::uint64_t RawDigest(const Player& player) {
  WordDigest digest;
  for (const std::int32_t figure :
       {player.ShotCount, player.HealCount, player.AmmoAddCount, player.AdminKillCount, player.RespawnCount,
        player.DeathCount, player.RunCounter, player.ExplosiveDamage, player.RadiationDamage,
        player.StunCount}) {
    digest.Add(figure);
  }
  for (const std::int32_t damage : player.HitByPlayer) {
    digest.Add(damage);
  }
  return digest.Value();
}

std::uint64_t FiguresDigest(const Game& game) {
  WordDigest digest;
  for (const Player& player : game.Players) {
    if (player.Active) {
      digest.Add(player.TotalDamage);
      digest.Add(player.AbsoluteDamage);
      digest.Add(player.Soldiering);
    }
  }
  return digest.Value();
}

}  // namespace

GameKeeper::GameKeeper(Parts parts)
    : parts_(std::move(parts)),
      subscription_(parts_.Session.Listen([this](SessionChange change) { Hear(change); })) {
  parts_.Session.BeforeClear = [this] { Keep(); };
}

GameKeeper::~GameKeeper() {
  parts_.Session.BeforeClear = nullptr;
}

void GameKeeper::Hear(SessionChange change) {
  switch (change) {
    case SessionChange::Cleared:
      Forget();
      break;
    case SessionChange::Loaded:
      source_ = GameSource::File;
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
  state_.KeptAt.clear();
  state_.Failure.clear();
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
    OpenFile();
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
  if (ended_ || std::exchange(keeping_, true)) {
    return;
  }
  try {
    action();
    state_.Failure.clear();
  } catch (const RuntimeError& error) {
    state_.Failure = error.what();
  }
  keeping_ = false;
}

void GameKeeper::Keep() {
  if (ended_ || keeping_ || opening_ || !parts_.Session.Game().DataPresent) {
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

void GameKeeper::Write(const Game& game, const Marks& now) {
  if (parts_.Disk.FreeSpace(parts_.UserDataFolder) < LeastFreeSpace) {
    throw RuntimeError(Fault::DiskFull, parts_.Strings.Text(OwnText::KeeperDiskFull));
  }
  GameArchive archive = Archive();
  const FormerState former = FormerOf(now);
  pulls_ += pullBegun_ && (!kept_ || kept_->Raw != now.Raw) ? 1 : 0;
  if (!gameId_ && source_ == GameSource::File && pulls_ == 0) {
    FindIn(archive, game);
  } else if (gameId_ && archive.KeepAgain(*gameId_, StateOf(game), former)) {
    lastStateIsElse_ = false;
  } else {
    gameId_.reset();
  }
  if (!gameId_) {
    formerPulls_ = 0;
    gameId_ = archive.Keep(StateOf(game));
    lastStateIsElse_ = false;
  }
  kept_ = now;
  pullBegun_ = false;
  state_.KeptAt = parts_.Time.ShortTime();
}

void GameKeeper::FindIn(GameArchive& archive, const Game& game) {
  if (const auto found = archive.FindState(game, parts_.Session.Missions().Text())) {
    gameId_ = found->GameId;
    lastStateIsElse_ = found->State != 0;
    NotePulls();
  }
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

GameState GameKeeper::StateOf(const Game& game) const {
  return {.Game = game,
          .Mission = parts_.Session.Missions().Text(),
          .Played = Played(),
          .Source = source_,
          .Pulls = std::max(1, formerPulls_ + pulls_),
          .Factors = parts_.Session.Factors()};
}

std::string GameKeeper::Played() const {
  const std::string told =
      source_ == GameSource::File ? parts_.Time.Stamp(parts_.Session.Game().GameDate) : std::string();
  return told.empty() ? parts_.Progress.Received() : told;
}

bool GameKeeper::ArchiveExists() const {
  return file_.Open || parts_.Disk.FileExists(parts_.UserDataFolder + "/games.mdb");
}

void GameKeeper::OpenFile() {
  if (!file_.Open) {
    file_ = OpenArchive(parts_.Engine, parts_.Disk, parts_.UserDataFolder,
                        parts_.ProgramFolder + "/games_default.mdb");
    state_.Unusable = file_.Unusable;
  }
}

GameArchive GameKeeper::Archive() {
  OpenFile();
  return {*file_.Open, parts_.Session.DbMembers(), parts_.Strings};
}

void GameKeeper::CheckMembers() {
  Try([this] {
    if (!ArchiveExists()) {
      return;
    }
    for (const CutMember& cut : Archive().CheckMembers()) {
      state_.CutGames += cut.Games;
    }
  });
}

void GameKeeper::RemoveDeleted() {
  Try([this] {
    if (ArchiveExists()) {
      Archive().RemoveDeleted(LastTimeOfRemoved(parts_.Time.Now()));
    }
  });
}

void GameKeeper::NoteMembers() {
  Try([this] {
    if (file_.Open) {
      Archive().Known().NoteChanges();
    }
  });
}

void GameKeeper::End() {
  Keep();
  ended_ = true;
  subscription_.End();
  file_.Open.reset();
}
