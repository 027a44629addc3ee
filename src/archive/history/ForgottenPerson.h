#pragma once

#include <cstdint>
#include <map>
#include <memory>
#include <set>
#include <string>
#include <vector>

#include "archive/GamePersons.h"
#include "archive/KnownMembers.h"
#include "platform/Database.h"

/// Who is to be forgotten: under which numbers and buttons he stands in the archive and in each of its
/// copies. In an old copy a person can have another number or another button than today, and games in which
/// nobody knew his number name him by his button alone. His number of today can be another one's there.
class ForgottenPerson {
 public:
  /// `members` must outlive this object. Reads it, and throws RuntimeError as it does.
  ForgottenPerson(std::int32_t number, Database& members);

  /// Reads whom an archive or a copy knows; the one in use first. Throws RuntimeError as databases do.
  void Read(const std::string& path, std::unique_ptr<Database> archive);

  /// All are read. Closes them. Throws RuntimeError as the member table does.
  void Finish();

  /// Whom to take out of that file; of one that could not be read, what the others tell.
  GamePersons In(const std::string& path) const;
  /// Whom to take out of the game on the board.
  GamePersons OnBoard() const { return In({}); }

 private:
  struct Archive {
    std::string Path;
    std::unique_ptr<Database> Open;
    KnownMembers::Marks Known;
    std::set<std::int32_t> Numbers;  ///< of the person
    bool HasPendingCut = false;      ///< of the number of today: later games there name the person
  };

  void Add(const MemberMark& mark);
  bool IsPerson(Archive& archive, std::int32_t number, const MemberMark& mark);
  bool FindNumbers(Archive& archive);
  void ReadGuestButtons(const Archive& archive);
  bool IsOfAnother(const std::string& button);
  bool IsSomebodyElse(const Archive& archive) const;
  bool SharesAGame(const Archive& archive) const;

  const std::int32_t number_;
  Database& members_;
  std::set<std::string> buttons_;
  std::set<std::string> digests_;  ///< under the keys of all archives
  std::set<std::string> guestButtons_;
  std::vector<Archive> archives_;
  std::map<std::string, std::set<std::int32_t>> numbers_;
};
