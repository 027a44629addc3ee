#include "archive/MemberCheck.h"

#include "archive/GameArchive.h"
#include "archive/KnownMembers.h"
#include "platform/Sql.h"

MemberCheck::MemberCheck(const Parts& parts)
    : pass_(parts.Archive, {.Numbers = KnownMembers(parts.Archive, parts.Members).FindStrangers()},
            GameArchive::Task::TakeOut) {
  KnownMembers(parts.Archive, parts.Members).RaiseCounter();
}

bool MemberCheck::Step(const Parts& parts) {
  if (Strangers().empty()) {
    return false;
  }
  if (pass_.Step(parts.Archive, GameArchive(parts.Archive, parts.Members, parts.Strings))) {
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
  scope.Commit();
}
