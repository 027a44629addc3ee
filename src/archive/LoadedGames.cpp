// What the keeper does about games that come onto the board from a file or from the archive itself.

#include "archive/ArchiveQueries.h"
#include "archive/GameKeeper.h"
#include "archive/PlayedTime.h"

void GameKeeper::Open(std::int64_t gameId, std::int64_t state, const Game& game,
                      const std::string& missionName) {
  gameId_ = gameId;
  lastStateIsElse_ = state != 0;
  loading_ = InputsDigest(game, missionName);
  Try([this] {
    GameArchive archive = Archive();
    played_ = archive.PlayedOf(*gameId_);
    NotePulls();
  });
}

void GameKeeper::Load(const Game& game, const std::string& missionName, const std::string& fileTime) {
  fileTime_ = fileTime;
  loading_ = InputsDigest(game, missionName);
  inFile_ = loading_;
  read_ = ReadGame{game, missionName};
  Try([this] {
    if (ArchiveExists(parts_.Disk, parts_.UserDataFolder)) {
      GameArchive archive = Archive();
      FindRead(archive);
    }
    read_.reset();  // or it is looked for when it is to be kept
  });
}

void GameKeeper::EndLoading() {
  if (!loading_) {
    return;
  }
  if (inFile_) {
    inFile_ = UncommittedInputs(parts_.Session.Game());
  }
  if (gameId_) {
    // A mission that is gone, or a button that has an owner now, make other inputs of it without the
    // operator.
    const Marks now = MarksOf(parts_.Session.Game());
    lastStateIsElse_ = lastStateIsElse_ || now.Inputs != *loading_;
    kept_ = now;
    state_.KeptAt = parts_.Time.ShortTime();
  }
  loading_.reset();
}

void GameKeeper::FindRead(GameArchive& archive) {
  source_ = GameSource::File;  // of which Played asks
  GoOnWith(archive, read_->Game, read_->Mission);
}

bool GameKeeper::Recognise(GameArchive& archive, const Game& game, bool isLoaded) {
  const std::string mission = parts_.Session.Missions().Text();
  if (read_) {
    const bool isAsRead = InputsDigest(read_->Game, read_->Mission) == InputsDigest(game, mission);
    const bool isThere = GoOnWith(archive, read_->Game, read_->Mission) && isAsRead;
    lastStateIsElse_ = lastStateIsElse_ || !isAsRead;
    read_.reset();
    if (gameId_) {
      return isThere;
    }
  }
  const bool isLost = gameId_ && archive.PlayedOf(*gameId_) != played_;
  if (isLost) {
    gameId_.reset();
  }
  if (!isLost && !(isLoaded && !kept_)) {
    return false;
  }
  return GoOnWith(archive, game, mission) && isLoaded;
}

bool GameKeeper::GoOnWith(GameArchive& archive, const Game& game, const std::string& missionName) {
  std::optional<GameArchive::FoundState> found = archive.FindState(game, missionName);
  const bool isSame = found.has_value();
  if (!found) {
    found = archive.FindAlike(game, missionName, Played(game));
  }
  if (!found) {
    return false;
  }
  gameId_ = found->GameId;
  played_ = archive.PlayedOf(*gameId_);
  lastStateIsElse_ = found->State != 0 || !isSame;
  if (pulls_ == 0) {
    NotePulls();
  }
  return isSame;
}

void GameKeeper::NotePulls() {
  const std::optional<ListedGame> row = ArchiveQueries(file_.Open->Statements()).Game(*gameId_);
  formerPulls_ = row ? row->Pulls : 0;
}

std::string GameKeeper::Played(const Game& game) const {
  std::string received = parts_.Progress.Received();
  if (source_ != GameSource::File) {
    return received;
  }
  return TimePlayed(game.GameDate, fileTime_.empty() ? received : fileTime_, parts_.Time);
}
