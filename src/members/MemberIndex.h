#pragma once

#include <cstddef>
#include <string>
#include <unordered_map>
#include <vector>

#include "members/MemberRow.h"

/// Who is the same member as who: the one with the same button, else the one with the same first and last
/// name and birth date. Letters of the alphabet count the same in both cases, and blanks around a name do
/// not count.
class MemberIndex {
 public:
  enum class Answer { None, One, Several, BirthdateMissing };

  /// What stands for a member; the caller's own numbering.
  using Reference = std::size_t;

  struct Match {
    Answer Found = Answer::None;
    Reference Who = 0;
  };

  void Add(const MemberValues& member, Reference who);

  /// A button is looked for first; the names only if it finds nobody. BirthdateMissing: the names alone are
  /// the same, and one of both sides has no birth date.
  Match Find(const MemberValues& member) const;

  /// Forgets up to so many buttons and names. False once there is none left: to forget very many at once
  /// takes a noticeable time.
  bool ForgetSome(std::size_t count);

 private:
  struct Named {
    std::string Birthdate;  ///< "YYYY-MM-DD", empty without one
    Reference Who;
  };

  std::unordered_map<std::string, std::vector<Reference>> byButton_;
  std::unordered_map<std::string, std::vector<Named>> byName_;
};
