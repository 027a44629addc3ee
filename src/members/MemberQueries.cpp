#include "members/MemberQueries.h"

namespace {

std::string WithDoubledApostrophes(const std::string& text) {
  std::string doubled;
  for (const char character : text) {
    doubled.append(character == '\'' ? 2 : 1, character);
  }
  return doubled;
}

}  // namespace

std::string SearchQuery(const std::string& text) {
  if (text.empty()) {
    return AllMembers;
  }
  const std::string pattern = text + "*";
  return AllMembers + (" WHERE ([FirstName] LIKE '" + pattern + "' OR [LastName] LIKE '" + pattern +
                       "' OR [NickName] LIKE '" + pattern + "')");
}

std::string HitsQuery(const std::string& text) {
  return SearchQuery(WithDoubledApostrophes(text));
}

std::string NameQuery(const std::string& firstName, const std::string& lastName) {
  return AllMembers + (" WHERE ([FirstName] = '" + WithDoubledApostrophes(firstName) +
                       "' AND [LastName] = '" + WithDoubledApostrophes(lastName) + "')");
}

std::string ButtonQuery(const std::string& dallasId) {
  return AllMembers + (" WHERE DallasID = '" + dallasId + "'");
}
