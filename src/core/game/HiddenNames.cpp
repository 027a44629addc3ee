#include "core/game/HiddenNames.h"

#include <charconv>
#include <string_view>
#include <utility>

#include "platform/RuntimeError.h"

namespace {

constexpr std::string_view MemberWord = "member ";
constexpr std::string_view GuestWord = "guest ";

}  // namespace

NameHolder HolderOf(const Game& game, int index, const NickNames& nickNames, const GuestNames& guestNames) {
  const std::int32_t contactId = game.Players(index).MemberIndex;
  return {.Member = contactId,
          .NickName = contactId != 0 ? CleanName(nickNames(contactId)) : std::string(),
          .GuestName = guestNames ? CleanName(guestNames(index)) : std::string()};
}

void LeaveOutHidden(std::vector<Standing>& standings, const Game& game, const HiddenNames& hidden,
                    const NickNames& nickNames, const GuestNames& guestNames) {
  for (Standing& standing : standings) {
    if (hidden.Hides(HolderOf(game, standing.Index, nickNames, guestNames))) {
      standing.PublicName = GunName(game, standing.Index);
    }
  }
}

HiddenNames::HiddenNames(Files& disk, std::string path) : disk_(disk), path_(std::move(path)) {
  try {
    if (disk_.FileExists(path_)) {
      Read();
    }
  } catch (const RuntimeError&) {
    readable_ = false;
  }
}

void HiddenNames::Read() {
  const std::string bytes = disk_.Read(path_);
  std::string_view rest = bytes;
  while (!rest.empty()) {
    std::string_view line = rest.substr(0, rest.find('\n'));
    rest.remove_prefix(std::min(line.size() + 1, rest.size()));
    if (line.starts_with(MemberWord)) {
      line.remove_prefix(MemberWord.size());
      std::int32_t number = 0;
      const auto [end, fault] = std::from_chars(line.data(), line.data() + line.size(), number);
      if (fault == std::errc() && number != 0) {
        members_.insert(number);
      }
    } else if (line.starts_with(GuestWord)) {
      if (std::string name = CleanName(line.substr(GuestWord.size())); !name.empty()) {
        guests_.insert(std::move(name));
      }
    }
  }
}

bool HiddenNames::HidesMember(std::int32_t contactId) const {
  return !readable_ || members_.contains(contactId);
}

bool HiddenNames::Hides(const NameHolder& holder) const {
  const std::string& name = holder.NickName.empty() ? holder.GuestName : holder.NickName;
  return !readable_ || (holder.Member != 0 && members_.contains(holder.Member)) || guests_.contains(name);
}

std::string HiddenNames::NameShown(const NameHolder& holder) const {
  if (Hides(holder)) {
    return {};
  }
  return holder.NickName.empty() ? holder.GuestName : holder.NickName;
}

bool HiddenNames::Hide(const NameHolder& holder) {
  if (holder.Member != 0) {
    members_.insert(holder.Member);
  } else if (!holder.GuestName.empty()) {
    guests_.insert(holder.GuestName);
  } else {
    return false;
  }
  Changed();
  return true;
}

void HiddenNames::ShowMember(std::int32_t contactId) {
  if (members_.erase(contactId) > 0) {
    Changed();
  }
}

void HiddenNames::ShowGuest(const std::string& name) {
  if (guests_.erase(name) > 0) {
    Changed();
  }
}

void HiddenNames::Changed() {
  if (OnChange) {
    OnChange();
  }
  if (!readable_) {
    disk_.Read(path_);  // throws: what the file holds must not be lost
    readable_ = true;
    Read();
  }
  std::string bytes;
  for (const std::int32_t member : members_) {
    bytes.append(MemberWord).append(std::to_string(member)).append("\n");
  }
  for (const std::string& guest : guests_) {
    bytes.append(GuestWord).append(guest).append("\n");
  }
  disk_.ReplacePrivately(path_, bytes);
}
