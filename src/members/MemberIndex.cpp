#include "members/MemberIndex.h"

#include <algorithm>

#include "core/game/DallasId.h"
#include "core/text/Pieces.h"
#include "platform/Letters.h"

namespace {

std::string InSmallLetters(const std::string& text) {
  std::string letters(Trimmed(text, IsWhiteSpace));
  std::transform(letters.begin(), letters.end(), letters.begin(), LowerAscii);
  return letters;
}

/// Empty for somebody without a first and a last name.
std::string NameKey(const MemberValues& member) {
  const std::string first = InSmallLetters(TextIn(member, MemberPlace::FirstName));
  const std::string last = InSmallLetters(TextIn(member, MemberPlace::LastName));
  return first.empty() && last.empty() ? std::string() : first + '\n' + last;
}

std::string ButtonOf(const MemberValues& member) {
  std::string button = InSmallLetters(TextIn(member, MemberPlace::DallasId));
  return button == NoDallasId ? std::string() : button;
}

std::string BirthdateOf(const MemberValues& member) {
  constexpr std::size_t dateLength = 10;
  return TextIn(member, MemberPlace::Birthdate).substr(0, dateLength);
}

}  // namespace

void MemberIndex::Add(const MemberValues& member, Reference who) {
  if (std::string button = ButtonOf(member); !button.empty()) {
    byButton_[std::move(button)].push_back(who);
  }
  if (std::string name = NameKey(member); !name.empty()) {
    byName_[std::move(name)].push_back({BirthdateOf(member), who});
  }
}

MemberIndex::Match MemberIndex::Find(const MemberValues& member) const {
  const auto withButton = byButton_.find(ButtonOf(member));
  if (withButton != byButton_.end()) {
    return {withButton->second.size() == 1 ? Answer::One : Answer::Several, withButton->second.front()};
  }
  const auto named = byName_.find(NameKey(member));
  if (named == byName_.end()) {
    return {};
  }
  const std::string birthdate = BirthdateOf(member);
  Match match;
  for (const Named& other : named->second) {
    if (other.Birthdate == birthdate) {
      match = {match.Found == Answer::One || match.Found == Answer::Several ? Answer::Several : Answer::One,
               other.Who};
    } else if (match.Found == Answer::None && (other.Birthdate.empty() || birthdate.empty())) {
      match = {Answer::BirthdateMissing, other.Who};
    }
  }
  return match;
}

bool MemberIndex::ForgetSome(std::size_t count) {
  for (; count > 0 && !byButton_.empty(); --count) {
    byButton_.erase(byButton_.begin());
  }
  for (; count > 0 && !byName_.empty(); --count) {
    byName_.erase(byName_.begin());
  }
  return !byButton_.empty() || !byName_.empty();
}
