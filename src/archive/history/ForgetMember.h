#pragma once

#include <cstdint>
#include <functional>
#include <optional>
#include <string>
#include <vector>

#include "archive/history/ForgottenPerson.h"
#include "core/text/StringTable.h"
#include "platform/Database.h"
#include "platform/Files.h"

/// How the forgetting of a member ended.
struct Forgotten {
  int Games = 0;         ///< of the archive in use that named the member in any state
  bool Stopped = false;  ///< what was not done by then is among the failures
  /// What could not be done, a sentence for the operator each; empty if the member stands nowhere any more.
  std::vector<std::string> Failures = {};
};

/// Has the archive of games, and all copies of it, forget a member. The member table, the game on the board
/// and files that the operator saved are left alone.
class ForgetMember {
 public:
  /// All must outlive this object.
  struct Parts {
    DatabaseEngine& Engine;
    Files& Disk;
    Database& DbMembers;
    const StringTable& Strings;
    std::string UserDataFolder;
  };

  /// How far it is.
  struct State {
    bool Counting = false;  ///< games, before anything is forgotten
    std::string File = {};  ///< that is being worked on, without its folder
    double Done = 0;        ///< of all, from 0 to 1
  };
  /// Asked often; may process events. False stops.
  using OnStep = std::function<bool(const State& state)>;

  /// Nothing is read yet.
  ForgetMember(Parts parts, std::int32_t number);

  /// How many games of the archive in use name the member in any of their states, by number or by button,
  /// deleted ones included; none if it was stopped. Throws RuntimeError as databases do.
  std::optional<int> CountGames(const OnStep& onStep);

  /// To be called after CountGames. Each file is written anew, without what was there of the member; the
  /// archive in use comes last. One that fails is told and does not keep the others from it. After a stop it
  /// can be done again.
  Forgotten Forget(const OnStep& onStep);

  /// Whom the game on the board is to be kept without. To be called after CountGames.
  GamePersons OnBoard() const { return person_->OnBoard(); }

 private:
  /// The archive, and the one that was begun beside it when it could not be used; the one in use is the last.
  std::vector<std::string> Archives() const;
  void Identify();
  void DeleteLeftFiles(std::vector<std::string>& failures) const;
  bool ForgetIn(const std::string& file, Forgotten& forgotten, const OnStep& onStep);
  bool TakeOutOf(Database& database, const std::string& file, Forgotten& forgotten, const OnStep& onStep);
  bool WriteAnew(Database& database, const std::string& file, const OnStep& onStep);
  void CheckRoomFor(std::uint64_t bytes, const std::string& file) const;
  bool Ask(const OnStep& onStep, const std::string& file, double ofFile) const;

  const Parts parts_;
  const std::int32_t number_;
  std::optional<ForgottenPerson> person_;
  std::uint64_t bytesOfAll_ = 1;
  std::uint64_t bytesDone_ = 0;
  std::uint64_t bytesOfFile_ = 0;
};
