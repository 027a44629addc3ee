#pragma once

#include <cstdint>
#include <map>
#include <set>
#include <string>
#include <vector>

#include "platform/Database.h"

/// What tells a member apart, as the archive keeps it. Both texts are empty for a number without a member.
struct MemberMark {
  std::string DallasId;  ///< empty without a button
  std::string Digest;    ///< keyed, of names and birth date

  bool operator==(const MemberMark&) const = default;
};

/// True if both are one member: the same button, or the same names and birth date.
bool IsSameMember(const MemberMark& one, const MemberMark& other);

/// The members whose numbers stand in the archive. Numbers change hands with a new members file, with one
/// brought back or taken over, and with another venue's: what an old game says must not then be told of
/// somebody else.
///
/// All operations throw RuntimeError as the databases do.
class KnownMembers {
 public:
  using Marks = std::map<std::int32_t, MemberMark>;

  /// Both must outlive this object.
  KnownMembers(Database& archive, Database& members) : archive_(archive), members_(members) {}

  /// What the member table says now about these numbers; empty marks for those that it does not have. Reads
  /// both databases; makes the archive's key if it has none yet.
  Marks Read(const std::vector<std::int32_t>& numbers);

  /// Notes marks that were read, unless the number is known already as nobody's or somebody else's: who was
  /// deleted stays known, and who had the number before, until that was checked. Call it within the group of
  /// writes that keeps their game.
  void Note(const Marks& marks);

  /// Notes what the member table says now about all known numbers but `strangers`. To be called after the
  /// operator has changed members, so that a new name and then a new button do not make somebody else of a
  /// member.
  void NoteChanges(const std::set<std::int32_t>& strangers = {});

  /// The known numbers that belong to somebody else now. Those who only changed their name or their button
  /// are noted anew.
  std::set<std::int32_t> FindStrangers();

  /// All known numbers.
  Marks All();

  /// From now on new members get numbers that no game has. Numbers above HighestMemberNumber, which no new
  /// member comes to, do not count.
  void RaiseCounter();

  /// The same above those of these numbers that nobody has. To be called before a game that names them is
  /// kept.
  void RaiseCounterAbove(const Marks& marks);

  /// Takes the number out of the known ones.
  void Forget(std::int32_t number);

  /// Keeps the number without a mark, as if nobody had had it.
  void Blank(std::int32_t number);

 private:
  const std::string& Key();
  void Write(const Marks& marks);
  Marks ReadAll(const Marks& known);

  Database& archive_;
  Database& members_;
  std::string key_;
};
