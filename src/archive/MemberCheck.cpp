#include "archive/MemberCheck.h"

#include "archive/GameArchive.h"
#include "archive/KnownMembers.h"
#include "archive/PendingCuts.h"
#include "platform/Sql.h"

MemberCheck::MemberCheck(Database& archive, const Begun& begun)
    : pass_(archive, GameArchive::Task::TakeOut, begun.Ranges), new_(begun.New) {}

MemberCheck::Begun MemberCheck::Begin(const Parts& parts) {
  KnownMembers known(parts.Archive, parts.Members);
  known.RaiseCounter();
  const std::set<std::int32_t> strangers = known.FindStrangers();
  PendingCuts pending(parts.Archive);
  PendingCuts::Cuts cuts = pending.Read();
  std::set<std::int32_t> numbers = strangers;
  for (const auto& [number, cut] : cuts) {
    numbers.insert(number);
  }
  Begun begun;
  if (numbers.empty()) {
    return begun;
  }
  const std::int64_t last = WholeNumber(parts.Archive.Statements(), "SELECT max(GameID) FROM Games");
  for (const auto& [number, mark] : known.Read({numbers.begin(), numbers.end()})) {
    const auto cut = cuts.find(number);
    const bool isOfNobody = mark == MemberMark{};
    if (cut == cuts.end() || (!isOfNobody && !IsSameMember(cut->second.Owner, mark))) {
      // Who had the number when an earlier check began may have it again; then all later games are of others.
      const std::int64_t first = strangers.contains(number) ? 1 : cut->second.Last + 1;
      cuts[number] = {.First = first, .Last = last, .Owner = mark};
      begun.New.insert(number);
    } else if (!isOfNobody) {
      cut->second.Owner = mark;  // with today's name and button
    }
    begun.Ranges[number] = {.First = cuts[number].First, .Last = cuts[number].Last};
  }
  pending.Write(cuts);
  return begun;
}

bool MemberCheck::Step(const Parts& parts) {
  if (Strangers().empty()) {
    return false;
  }
  if (pass_.Step(parts.Archive, GameArchive(parts.Archive, parts.Members, parts.Strings),
                 [&parts](std::int64_t game) { PendingCuts(parts.Archive).NoteDone(game); })) {
    return true;
  }
  Finish(parts);
  return false;
}

void MemberCheck::Finish(const Parts& parts) {
  KnownMembers known(parts.Archive, parts.Members);
  // Games that were kept meanwhile may name those who have the numbers now.
  std::vector<std::int32_t> named;
  for (const std::int32_t number : Strangers()) {
    if (WholeNumber(parts.Archive.Statements(), "SELECT count(*) FROM GamePlayers WHERE MemberID = $1",
                    {std::int64_t{number}}) > 0) {
      named.push_back(number);
    }
  }
  const KnownMembers::Marks marks = known.Read(named);
  WriteScope scope(parts.Archive);
  for (const std::int32_t number : Strangers()) {
    known.Forget(number);
  }
  known.Note(marks);
  PendingCuts(parts.Archive).Drop(Strangers());
  scope.Commit();
}
