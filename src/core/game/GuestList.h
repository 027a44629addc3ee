#pragma once

#include <map>
#include <string>
#include <utility>

/// The names that players without a membership have in the game on the board, by the record of their gun.
class GuestList {
 public:
  using Names = std::map<int, std::string>;

  /// Empty without one.
  std::string NameOf(int index) const {
    const auto found = names_.find(index);
    return found == names_.end() ? std::string() : found->second;
  }

  void SetNames(Names names) { names_ = std::move(names); }
  const Names& All() const { return names_; }

  /// The next game has other guests.
  void Forget() { names_.clear(); }

 private:
  Names names_;
};
