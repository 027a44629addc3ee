#include "archive/history/ArchivedMembers.h"

#include <algorithm>
#include <tuple>

#include "core/data/FieldValue.h"

namespace {

/// Whole numbers of members may be many: from here on the table is read once instead of a row for each.
constexpr std::size_t MostSingleReads = 2000;

std::string NameInRow(const SqlRow& row) {
  const std::string first = TextOf(row[1]);
  const std::string last = TextOf(row[2]);
  const std::string nickName = TextOf(row[3]);
  std::string name = first;
  name.append(first.empty() || last.empty() ? "" : " ").append(last);
  if (!nickName.empty()) {
    name.append(name.empty() ? "" : " ").append("\"").append(nickName).append("\"");
  }
  return name;
}

void Identify(ArchivedMember& member, const SqlRow& row) {
  member.IsMember = true;
  member.Name = NameInRow(row);
}

/// `members` are in the order of their numbers.
void IdentifyAll(std::vector<ArchivedMember>& members, Database& database) {
  const std::string columns = "SELECT ContactID, FirstName, LastName, NickName FROM Members";
  if (members.size() > MostSingleReads) {
    database.Statements().Query(columns, {}, [&members](const SqlRow& row) {
      const std::int64_t number = row.Integer(0);
      const auto found = std::ranges::lower_bound(members, number, {}, &ArchivedMember::Number);
      if (found != members.end() && found->Number == number) {
        Identify(*found, row);
      }
    });
    return;
  }
  const ReadScope scope(database);
  const std::string one = columns + " WHERE ContactID = $1";
  for (ArchivedMember& member : members) {
    database.Statements().Query(one, {std::int64_t{member.Number}},
                                [&member](const SqlRow& row) { Identify(member, row); });
  }
}

std::string InSmallLetters(const std::string& text) {
  std::string letters = text;
  for (char& letter : letters) {
    letter = letter >= 'A' && letter <= 'Z' ? static_cast<char>(letter - 'A' + 'a') : letter;
  }
  return letters;
}

}  // namespace

std::vector<ArchivedMember> ArchivedMembers(Sql& archive, Database& members) {
  std::vector<ArchivedMember> all;
  archive.Query("SELECT MemberID, DallasID FROM KnownMembers ORDER BY MemberID", {},
                [&all](const SqlRow& row) {
                  all.push_back({.Number = static_cast<std::int32_t>(row.Integer(0)), .Button = row.Text(1)});
                });
  IdentifyAll(all, members);
  std::ranges::stable_sort(all, {}, [](const ArchivedMember& member) {
    return std::tuple(!member.IsMember, InSmallLetters(member.Name));
  });
  return all;
}

void IncludeMember(std::vector<ArchivedMember>& all, std::int32_t number, Database& members) {
  if (std::ranges::find(all, number, &ArchivedMember::Number) != all.end()) {
    return;
  }
  std::vector<ArchivedMember> one{{.Number = number}};
  IdentifyAll(one, members);
  if (one.front().IsMember) {
    all.insert(all.begin(), one.front());
  }
}

bool IsFound(const ArchivedMember& member, const std::string& text) {
  const std::string wanted = InSmallLetters(text);
  return wanted.empty() || std::to_string(member.Number) == wanted ||
         InSmallLetters(member.Name).find(wanted) != std::string::npos ||
         InSmallLetters(member.Button).find(wanted) != std::string::npos;
}
