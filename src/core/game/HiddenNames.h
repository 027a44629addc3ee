#pragma once

#include <cstdint>
#include <functional>
#include <set>
#include <string>
#include <vector>

#include "core/game/PublicName.h"
#include "core/game/Standings.h"
#include "platform/Files.h"

/// Whose name a player's public name is.
struct NameHolder {
  std::int32_t Member = 0;     ///< `ContactID`; 0 without a membership
  std::string NickName = {};   ///< of the member, clean
  std::string GuestName = {};  ///< in this game, clean

  bool operator==(const NameHolder&) const = default;
};

/// The holder of the name of the player at record `index`. Without `guestNames` there are no guests.
NameHolder HolderOf(const Game& game, int index, const NickNames& nickNames,
                    const GuestNames& guestNames = {});

class HiddenNames;

/// Puts the gun in the place of each public name in `standings` that `hidden` hides.
void LeaveOutHidden(std::vector<Standing>& standings, const Game& game, const HiddenNames& hidden,
                    const NickNames& nickNames, const GuestNames& guestNames = {});

/// The names that the operator has taken off all public screens, pages and lists, until they are shown again.
/// They outlive the program, in a file of their own that only this user may read.
class HiddenNames {
 public:
  /// `disk` must outlive this. The file need not exist. While it cannot be read, all names are hidden.
  HiddenNames(Files& disk, std::string path);

  /// Called after each change.
  std::function<void()> OnChange;

  bool Hides(const NameHolder& holder) const;

  /// Nickname or guest name; empty where the gun alone may be shown.
  std::string NameShown(const NameHolder& holder) const;

  /// True for a member whose name is hidden wherever it would stand.
  bool HidesMember(std::int32_t contactId) const;

  /// Hides the member for good, and a guest by the name. Returns false, with nothing done, for a holder
  /// without either. It is hidden also where the file cannot be written, which throws RuntimeError as
  /// Files::Replace does.
  bool Hide(const NameHolder& holder);

  /// Take it back. Throw as Hide does.
  void ShowMember(std::int32_t contactId);
  void ShowGuest(const std::string& name);

  const std::set<std::int32_t>& Members() const { return members_; }
  const std::set<std::string>& Guests() const { return guests_; }

 private:
  void Read();
  void Changed();

  Files& disk_;
  const std::string path_;
  std::set<std::int32_t> members_;
  std::set<std::string> guests_;
  bool readable_ = true;
};
