#include "web/PageSetup.h"

#include <algorithm>
#include <charconv>

namespace {

constexpr const char* NamesOnBoard = "board";
constexpr const char* NamesOnAll = "all";
constexpr const char* NoNames = "none";

/// The number at `setting`, or its default where that is none from `least` to `most`.
int WholeNumberAt(const IniReader& ini, const Setting& setting, int least, int most) {
  const auto numberIn = [](const std::string& text) {
    int number = 0;
    const auto [end, fault] = std::from_chars(text.data(), text.data() + text.size(), number);
    return fault == std::errc() && end == text.data() + text.size() ? number : -1;
  };
  const int number = numberIn(ini.ReadIni(setting));
  return number >= least && number <= most ? number : numberIn(setting.Default);
}

NamesShown NamesIn(const std::string& text) {
  if (text == NoNames) {
    return NamesShown::Nowhere;
  }
  return text == NamesOnAll ? NamesShown::OnBoardAndPage : NamesShown::OnBoard;
}

const char* TextOfNames(NamesShown names) {
  switch (names) {
    case NamesShown::OnBoardAndPage:
      return NamesOnAll;
    case NamesShown::Nowhere:
      return NoNames;
    case NamesShown::OnBoard:
      break;
  }
  return NamesOnBoard;
}

/// The values as the file holds them.
IniReader::Values SetupValues(const PageSetup& setup) {
  return {{Keys::ResultsOn.Key, setup.On ? "1" : "0"},
          {Keys::ResultsAddress.Key, setup.Address},
          {Keys::ResultsPort.Key, std::to_string(setup.Port)},
          {Keys::ResultsNames.Key, TextOfNames(setup.Names)},
          {Keys::ResultsGames.Key, std::to_string(setup.Games)},
          {Keys::ResultsWithBoard.Key, setup.WithBoard ? "1" : "0"},
          {Keys::ResultsRanking.Key, setup.Ranking ? "1" : "0"}};
}

}  // namespace

PageSetup ReadPageSetup(const IniReader& ini) {
  using namespace PageLimits;
  PageSetup setup;
  setup.On = ini.ReadIni(Keys::ResultsOn) == "1";
  setup.Address = ini.ReadIni(Keys::ResultsAddress);
  setup.Port = static_cast<std::uint16_t>(WholeNumberAt(ini, Keys::ResultsPort, LeastPort, MostPort));
  setup.Names = NamesIn(ini.ReadIni(Keys::ResultsNames));
  setup.Games = WholeNumberAt(ini, Keys::ResultsGames, LeastGames, MostGames);
  setup.WithBoard = ini.ReadIni(Keys::ResultsWithBoard) == "1";
  setup.Ranking = ini.ReadIni(Keys::ResultsRanking) == "1";
  return setup;
}

void WritePageSetup(IniReader& ini, const PageSetup& before, const PageSetup& now) {
  const IniReader::Values old = SetupValues(before);
  IniReader::Values changed;
  for (const auto& value : SetupValues(now)) {
    if (std::ranges::find(old, value) == old.end()) {
      changed.push_back(value);
    }
  }
  if (!changed.empty()) {
    ini.WriteIni(Keys::ResultsOn.Section, changed);
  }
}
