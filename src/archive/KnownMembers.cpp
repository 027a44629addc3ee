#include "archive/KnownMembers.h"

#include <algorithm>
#include <optional>
#include <string_view>

#include "archive/Digests.h"
#include "core/data/FieldValue.h"
#include "core/game/DallasId.h"
#include "core/game/MemberNumbers.h"
#include "core/text/Pieces.h"
#include "platform/Sql.h"

namespace {

constexpr std::string_view MemberColumns =
    "SELECT ContactID, DallasID, FirstName, LastName, Birthdate FROM Members";

/// As a person writes it: capitals and blanks around it do not make another name.
std::string Plain(const Value& name) {
  const std::string text = TextOf(name);
  std::string plain(Trimmed(text, [](char character) { return character == ' '; }));
  for (char& character : plain) {
    character = character >= 'A' && character <= 'Z' ? static_cast<char>(character - 'A' + 'a') : character;
  }
  return plain;
}

/// The mark of the member in a row of MemberColumns.
MemberMark MarkOf(const SqlRow& row, std::string_view key) {
  constexpr std::size_t dateLength = 10;
  const std::string button = TextOf(row[1]);
  std::string person = Plain(row[2]);
  person.append(1, '\0').append(Plain(row[3]));
  person.append(1, '\0').append(TextOf(row[4]).substr(0, dateLength));
  return {button == NoDallasId ? std::string() : button, KeyedDigest(key, person)};
}

}  // namespace

bool IsSameMember(const MemberMark& one, const MemberMark& other) {
  const auto agree = [](const std::string& left, const std::string& right) {
    return !left.empty() && left == right;
  };
  return agree(one.DallasId, other.DallasId) || agree(one.Digest, other.Digest);
}

KnownMembers::Marks KnownMembers::Read(const std::vector<std::int32_t>& numbers) {
  const std::string query = std::string(MemberColumns) + " WHERE ContactID = $1";
  const std::string& key = Key();
  Marks marks;
  const ReadScope scope(members_);
  for (const std::int32_t number : numbers) {
    MemberMark& mark = marks[number];
    members_.Statements().Query(query, {std::int64_t{number}},
                                [&](const SqlRow& row) { mark = MarkOf(row, key); });
  }
  return marks;
}

void KnownMembers::Note(const Marks& marks) {
  Marks noted;
  for (const auto& [number, mark] : marks) {
    std::optional<MemberMark> known;
    archive_.Statements().Query("SELECT DallasID, Digest FROM KnownMembers WHERE MemberID = $1",
                                {std::int64_t{number}}, [&known](const SqlRow& row) {
                                  known = {row.Text(0), row.Text(1)};
                                });
    if (!known || (*known != mark && IsSameMember(*known, mark))) {
      noted[number] = mark;
    }
  }
  Write(noted);
}

void KnownMembers::Write(const Marks& marks) {
  for (const auto& [number, mark] : marks) {
    archive_.Statements().Change(
        "INSERT INTO KnownMembers (MemberID, DallasID, Digest) VALUES ($1, $2, $3) "
        "ON CONFLICT (MemberID) DO UPDATE SET DallasID = $2, Digest = $3",
        {std::int64_t{number}, mark.DallasId, mark.Digest});
  }
}

void KnownMembers::NoteChanges(const std::set<std::int32_t>& strangers) {
  const Marks known = All();
  Marks changed;
  for (const auto& [number, mark] : ReadAll(known)) {
    // Who has a number that nobody had when its games were kept did not play them.
    if (mark != known.at(number) && known.at(number) != MemberMark{} && !strangers.contains(number)) {
      changed[number] = mark;
    }
  }
  if (!changed.empty()) {
    WriteScope scope(archive_);
    Write(changed);
    scope.Commit();
  }
}

std::set<std::int32_t> KnownMembers::FindStrangers() {
  const Marks known = All();
  std::set<std::int32_t> strangers;
  Marks changed;
  for (const auto& [number, mark] : ReadAll(known)) {
    if (!IsSameMember(mark, known.at(number))) {
      strangers.insert(number);
    } else if (mark != known.at(number)) {
      changed[number] = mark;
    }
  }
  if (!changed.empty()) {
    WriteScope scope(archive_);
    Write(changed);
    scope.Commit();
  }
  return strangers;
}

void KnownMembers::RaiseCounter() {
  const std::int64_t highest =
      WholeNumber(archive_.Statements(), "SELECT max(MemberID) FROM KnownMembers WHERE MemberID <= $1",
                  {std::int64_t{HighestMemberNumber}});
  if (highest > 0) {
    members_.RaiseCounter("Members", highest);
  }
}

void KnownMembers::RaiseCounterAbove(const Marks& marks) {
  std::int64_t highest = 0;
  for (const auto& [number, mark] : marks) {
    if (mark == MemberMark{} && number <= HighestMemberNumber) {
      highest = std::max<std::int64_t>(highest, number);
    }
  }
  if (highest > 0) {
    members_.RaiseCounter("Members", highest);
  }
}

void KnownMembers::Forget(std::int32_t number) {
  archive_.Statements().Change("DELETE FROM KnownMembers WHERE MemberID = $1", {std::int64_t{number}});
}

void KnownMembers::Blank(std::int32_t number) {
  archive_.Statements().Change("UPDATE KnownMembers SET DallasID = '', Digest = '' WHERE MemberID = $1",
                               {std::int64_t{number}});
}

const std::string& KnownMembers::Key() {
  if (key_.empty()) {
    Sql& sql = archive_.Statements();
    const auto read = [&] {
      sql.Query("SELECT Secret FROM ArchiveKey WHERE KeyID = 1", {},
                [this](const SqlRow& row) { key_ = row.Text(0); });
    };
    read();
    if (key_.empty()) {
      sql.Change("INSERT INTO ArchiveKey (KeyID, Secret) VALUES (1, $1) ON CONFLICT (KeyID) DO NOTHING",
                 {RandomKey()});
      read();
    }
  }
  return key_;
}

KnownMembers::Marks KnownMembers::All() {
  Marks known;
  archive_.Statements().Query("SELECT MemberID, DallasID, Digest FROM KnownMembers", {},
                              [&known](const SqlRow& row) {
                                known[static_cast<std::int32_t>(row.Integer(0))] = {row.Text(1), row.Text(2)};
                              });
  return known;
}

/// The present marks of the known numbers that the member table has.
KnownMembers::Marks KnownMembers::ReadAll(const Marks& known) {
  Marks marks;
  if (known.empty()) {
    return marks;
  }
  const std::string& key = Key();
  members_.Statements().Query(std::string(MemberColumns), {}, [&](const SqlRow& row) {
    const auto number = static_cast<std::int32_t>(row.Integer(0));
    if (known.contains(number)) {
      marks[number] = MarkOf(row, key);
    }
  });
  return marks;
}
