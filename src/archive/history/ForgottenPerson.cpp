#include "archive/history/ForgottenPerson.h"

#include <functional>
#include <string>
#include <utility>

#include "archive/PendingCuts.h"
#include "core/game/IsButton.h"
#include "platform/RuntimeError.h"
#include "platform/Sql.h"

namespace {

/// What a damaged archive or copy does not tell, the others may; whoever changes it will tell of the damage.
bool IfReadable(const std::function<bool()>& read) {
  try {
    return read();
  } catch (const RuntimeError&) {
    return false;
  }
}

}  // namespace

ForgottenPerson::ForgottenPerson(std::int32_t number, Database& members)
    : number_(number), members_(members) {
  members.Statements().Query("SELECT DallasID FROM Members WHERE ContactID = $1", {std::int64_t{number}},
                             [this](const SqlRow& row) { Add({.DallasId = row.Text(0), .Digest = {}}); });
}

void ForgottenPerson::Add(const MemberMark& mark) {
  if (IsButton(mark.DallasId)) {
    buttons_.insert(mark.DallasId);
  }
  if (!mark.Digest.empty()) {
    digests_.insert(mark.Digest);
  }
}

void ForgottenPerson::Read(const std::string& path, std::unique_ptr<Database> archive) {
  KnownMembers known(*archive, members_);
  const bool hasPendingCut = PendingCuts(*archive).Read().contains(number_);
  Archive read{.Path = path,
               .Open = std::move(archive),
               .Known = known.All(),
               .Numbers = {},
               .HasPendingCut = hasPendingCut};
  if (!read.Known.empty()) {
    const MemberMark today = known.Read({number_})[number_];
    Add(today);
    const auto then = read.Known.find(number_);
    // Who is no member any more is the one whom the archive in use knows.
    if (archives_.empty() && today == MemberMark{} && then != read.Known.end()) {
      Add(then->second);
    }
  }
  archives_.push_back(std::move(read));
}

void ForgottenPerson::Finish() {
  // One file tells a button under which another one knows him, and that one other names.
  for (bool hasGrown = true; hasGrown;) {
    hasGrown = false;
    for (Archive& archive : archives_) {
      hasGrown = IfReadable([&] { return FindNumbers(archive); }) || hasGrown;
    }
  }
  guestButtons_ = buttons_;
  for (const Archive& archive : archives_) {
    IfReadable([&] {
      ReadGuestButtons(archive);
      return true;
    });
    std::set<std::int32_t>& numbers = numbers_[archive.Path];
    numbers = archive.Numbers;
    if (!IfReadable([&] { return IsSomebodyElse(archive); })) {
      numbers.insert(number_);
    }
  }
  std::erase_if(guestButtons_, [this](const std::string& button) { return IsOfAnother(button); });
  archives_.clear();
}

bool ForgottenPerson::FindNumbers(Archive& archive) {
  bool hasGrown = false;
  for (const auto& [number, mark] : archive.Known) {
    if (!archive.Numbers.contains(number) && IsPerson(archive, number, mark)) {
      archive.Numbers.insert(number);
      Add(mark);
      hasGrown = true;
    }
  }
  return hasGrown;
}

bool ForgottenPerson::IsPerson(Archive& archive, std::int32_t number, const MemberMark& mark) {
  if (digests_.contains(mark.Digest)) {
    return true;
  }
  if (!buttons_.contains(mark.DallasId)) {
    return false;
  }
  // A button can have been another member's before.
  return number == number_ ||
         KnownMembers(*archive.Open, members_).Read({number})[number].Digest != mark.Digest;
}

void ForgottenPerson::ReadGuestButtons(const Archive& archive) {
  std::set<std::int32_t> numbers = archive.Numbers;
  const auto known = archive.Known.find(number_);
  if (known == archive.Known.end() || known->second == MemberMark{}) {
    numbers.insert(number_);
  }
  for (const std::int32_t number : numbers) {
    archive.Open->Statements().Query("SELECT DISTINCT DallasID FROM GamePlayers WHERE MemberID = $1",
                                     {std::int64_t{number}}, [this](const SqlRow& row) {
                                       if (const std::string button = row.Text(0); IsButton(button)) {
                                         guestButtons_.insert(button);
                                       }
                                     });
  }
}

bool ForgottenPerson::IsOfAnother(const std::string& button) {
  return WholeNumber(members_.Statements(),
                     "SELECT count(*) FROM Members WHERE DallasID = $1 AND ContactID <> $2",
                     {button, std::int64_t{number_}}) > 0;
}

/// True if an archive or a copy knows another person under the number of today.
bool ForgottenPerson::IsSomebodyElse(const Archive& archive) const {
  const auto known = archive.Known.find(number_);
  const bool isToldByNumberAlone = digests_.empty() && buttons_.empty();
  return !isToldByNumberAlone && known != archive.Known.end() && known->second != MemberMark{} &&
         !archive.Numbers.contains(number_) && !archive.HasPendingCut && !SharesAGame(archive);
}

/// True if a game names the number in an old copy, and in the archive in use, which knows the person by it:
/// his name and his button are others since then.
bool ForgottenPerson::SharesAGame(const Archive& archive) const {
  const Archive& inUse = archives_.front();
  if (!inUse.Numbers.contains(number_)) {
    return false;
  }
  constexpr const char* games =
      "SELECT Games.GameID, Played FROM Games JOIN GamePlayers ON GamePlayers.GameID = Games.GameID "
      "WHERE MemberID = $1";
  std::set<std::pair<std::int64_t, std::string>> named;
  inUse.Open->Statements().Query(games, {std::int64_t{number_}},
                                 [&named](const SqlRow& row) { named.emplace(row.Integer(0), row.Text(1)); });
  bool shares = false;
  archive.Open->Statements().Query(games, {std::int64_t{number_}}, [&](const SqlRow& row) {
    shares = shares || named.contains({row.Integer(0), row.Text(1)});
  });
  return shares;
}

GamePersons ForgottenPerson::In(const std::string& path) const {
  const auto found = numbers_.find(path);
  return {.Numbers = found == numbers_.end() ? std::set{number_} : found->second,
          .GuestButtons = guestButtons_,
          .TakesButtons = true};
}
