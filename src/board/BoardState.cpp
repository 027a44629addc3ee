#include "board/BoardState.h"

#include <cmath>

#include "board/BoardLetters.h"
#include "core/text/NumberForms.h"

namespace {

constexpr const char* Section = "board";
constexpr const char* LettersKey = "letters";
constexpr double Parts = 10'000;  ///< shares are kept in ten-thousandths

std::string ColumnsKey(const std::string& list) {
  return list + "_columns";
}

}  // namespace

int BoardState::Letters() const {
  const double percent = Val(state_.ReadIni(Section, LettersKey, std::to_string(UsualPercent)));
  return percent >= SmallestPercent && percent <= LargestPercent ? static_cast<int>(percent) : UsualPercent;
}

void BoardState::SetLetters(int percent) {
  state_.WriteIni(Section, LettersKey, std::to_string(percent));
}

std::vector<double> BoardState::ColumnShares(const std::string& list) const {
  std::vector<double> shares;
  std::string rest = state_.ReadIni(Section, ColumnsKey(list), "");
  while (!rest.empty()) {
    const std::size_t comma = rest.find(',');
    shares.push_back(Val(rest.substr(0, comma)) / Parts);
    rest = comma == std::string::npos ? std::string() : rest.substr(comma + 1);
  }
  return shares;
}

void BoardState::SetColumnShares(const std::string& list, const std::vector<double>& shares) {
  std::string text;
  for (const double share : shares) {
    text += (text.empty() ? "" : ",") + std::to_string(std::lround(share * Parts));
  }
  state_.WriteIni(Section, ColumnsKey(list), text);
}
