#include "members/MemberColumns.h"

#include <algorithm>
#include <utility>

#include "core/text/Pieces.h"
#include "platform/Letters.h"

namespace {

/// Other words for some columns, as LettersOf gives them.
constexpr std::pair<std::string_view, std::size_t> UsualHeadings[] = {
    {"memberid", 0},     {"membernumber", 0},  {"memberno", 0},       {"id", 0},
    {"会员号", 0},       {"button", 1},        {"ibutton", 1},        {"buttonid", 1},
    {"memberidcode", 1}, {"信息扣", 1},        {"givenname", 2},      {"forename", 2},
    {"first", 2},        {"surname", 3},       {"familyname", 3},     {"last", 3},
    {"nick", 4},         {"alias", 4},         {"callsign", 4},       {"team", 5},
    {"birthday", 6},     {"dob", 6},           {"born", 6},           {"dateofbirth", 6},
    {"street", 7},       {"streetaddress", 7}, {"town", 8},           {"zip", 9},
    {"zipcode", 9},      {"postcode", 9},      {"postzipcode", 9},    {"postalzipcode", 9},
    {"email", 10},       {"emailaddress", 10}, {"mail", 10},          {"phone", 11},
    {"telephone", 11},   {"mobile", 11},       {"mobilephone", 11},   {"tel", 11},
    {"joined", 12},      {"membersince", 12},  {"dateofjoining", 12}, {"lastplayed", 13},
    {"games", 14},       {"gamesplayed", 14},  {"手机", 11},          {"电子邮箱", 10},
    {"出生年月日", 6},   {"姓氏", 3},
};

/// A heading in small letters, without blanks and marks.
std::string LettersOf(std::string_view heading) {
  std::string letters;
  for (const char letter : heading) {
    const auto byte = static_cast<unsigned char>(letter);
    const char lower = LowerAscii(letter);
    if (IsDigit(letter) || (lower >= 'a' && lower <= 'z') || byte >= 0x80) {
      letters += lower;
    }
  }
  return letters;
}

}  // namespace

std::vector<std::string> MemberColumnTitles(const StringTable& strings) {
  return PartsOf(strings.Text(OwnText::MemberColumnTitles), '|');
}

std::optional<std::size_t> ColumnOfHeading(std::string_view heading) {
  const std::string letters = LettersOf(heading);
  for (std::size_t column = 0; column < MemberColumns.size(); ++column) {
    if (LettersOf(MemberColumns[column].Name) == letters) {
      return column;
    }
  }
  for (const Language language : {Language::English, Language::SimplifiedChinese}) {
    const std::vector<std::string> titles = MemberColumnTitles(StringTable(language));
    const auto title = std::find_if(titles.begin(), titles.end(),
                                    [&](const std::string& text) { return LettersOf(text) == letters; });
    if (title != titles.end()) {
      return static_cast<std::size_t>(title - titles.begin());
    }
  }
  const auto* const usual = std::find_if(std::begin(UsualHeadings), std::end(UsualHeadings),
                                         [&](const auto& entry) { return entry.first == letters; });
  return usual == std::end(UsualHeadings) ? std::nullopt : std::optional(usual->second);
}
