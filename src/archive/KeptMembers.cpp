// What the keeper does about members in past games, and about games that were deleted.

#include "archive/DeletedGames.h"
#include "archive/GameKeeper.h"

MemberCheck::Parts GameKeeper::CheckParts() {
  return {.Archive = OpenFile(), .Members = parts_.Session.DbMembers(), .Strings = parts_.Strings};
}

void GameKeeper::CheckMembers() {
  check_.reset();
  membersUnchecked_ = true;
  Try([this] { CheckUnchecked(); });
}

void GameKeeper::CheckUnchecked() {
  if (!membersUnchecked_) {
    return;
  }
  if (ArchiveExists(parts_.Disk, parts_.UserDataFolder)) {
    CheckRoom();
    const MemberCheck::Parts parts = CheckParts();
    check_.emplace(parts);
    if (check_->Strangers().empty()) {
      check_.reset();
    }
  }
  membersUnchecked_ = false;
  if (check_) {
    TakeFromBoard({.Numbers = check_->NewStrangers()});
  }
}

void GameKeeper::TakeFromBoard(const GamePersons& persons) {
  if (persons.TakeFrom(parts_.Session.Game())) {
    parts_.Session.CalculateScoresWhenPresent();
  }
}

bool GameKeeper::CutAPart() {
  bool hasMore = false;
  if (check_) {
    Try([&] {
      CheckRoom();
      const MemberCheck::Parts parts = CheckParts();
      if (!check_) {  // of a file that has moved
        return;
      }
      const int before = check_->Games();
      hasMore = check_->Step(parts);
      state_.CutGames += check_->Games() - before;
      if (!hasMore) {
        check_.reset();
      }
    });
  }
  return hasMore && check_;
}

void GameKeeper::ForgetPersons(const GamePersons& persons) {
  forgotten_.TakesButtons = true;
  forgotten_.Numbers.insert(persons.Numbers.begin(), persons.Numbers.end());
  forgotten_.GuestButtons.insert(persons.GuestButtons.begin(), persons.GuestButtons.end());
}

void GameKeeper::NoteMembers() {
  Try([this] {
    CheckUnchecked();
    if (ArchiveExists(parts_.Disk, parts_.UserDataFolder)) {
      CheckRoom();
      Archive().Known().NoteChanges(check_ ? check_->Strangers() : std::set<std::int32_t>());
    }
  });
}

bool GameKeeper::RemoveDeleted() {
  constexpr int atOnce = 5;
  bool mayHaveMore = false;
  Try([&] {
    if (ArchiveExists(parts_.Disk, parts_.UserDataFolder)) {
      CheckRoom();
      mayHaveMore = Archive().RemoveDeleted(LastTimeOfRemoved(parts_.Time.Now()), atOnce) == atOnce;
    }
  });
  return mayHaveMore;
}
