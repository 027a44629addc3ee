#pragma once

#include <cstdint>
#include <functional>
#include <optional>
#include <string>
#include <vector>

#include "core/game/MemberRanking.h"
#include "core/text/StringTable.h"
#include "platform/Database.h"
#include "platform/Sql.h"

struct RankedMember {
  int Place = 0;  ///< equal ones share theirs
  RankedFigures Figures;
  std::string PublicName = {};  ///< nickname; empty without one, and for who hides the name
  std::string FullName = {};    ///< first and last name
};

/// As PlacedBy orders them, without names.
std::vector<RankedMember> Ranked(const std::vector<RankedFigures>& figures, RankedBy by,
                                 std::int64_t leastGames);

/// The month or year that follows: "2026-12" for "2026-11", "2027" for "2026". `period` has one of these
/// forms.
std::string PeriodAfter(const std::string& period);

/// Of all who played in kept games of a month ("2026-11") or a year ("2026"). Throws RuntimeError as Sql
/// does.
std::vector<RankedFigures> FiguresOfPeriod(Sql& archive, const std::string& period);

/// Asked between steps with the part done, 0 to 1; may process events. False stops the reading.
using RankingStep = std::function<bool(double done)>;

/// FiguresOfPeriod, month by month; nothing if it was stopped.
std::optional<std::vector<RankedFigures>> FiguresInSteps(Sql& archive, const std::string& period,
                                                         const RankingStep& goOn);

/// FiguresOfLifetime, where the best of the kept games is read month by month; nothing if it was stopped.
std::optional<std::vector<RankedFigures>> LifetimeInSteps(Sql& members, Sql& archive,
                                                          const RankingStep& goOn);

/// From the lifetime figures of all members with committed games. These know no best game: it is that of the
/// kept games, and is read only if there is an `archive`, from all of them. Throws RuntimeError as Sql does.
std::vector<RankedFigures> FiguresOfLifetime(Sql& members, Sql* archive);

/// True for a member whose name is to be shown nowhere.
using HidesName = std::function<bool(std::int32_t member)>;

/// Fills in the names of those who are members. Throws RuntimeError as Sql does.
void NameRanked(std::vector<RankedMember>& ranked, Database& members, const HidesName& hidesName = {});

/// The ranking as a table for other programs, with first and last names only if `fullNames`.
std::string RankingCsv(const std::vector<RankedMember>& ranked, bool fullNames, const StringTable& strings);

/// The same as a page to read and print.
std::string RankingPage(const std::string& title, const std::vector<RankedMember>& ranked, bool fullNames,
                        const StringTable& strings);

/// The texts of a row: place, name, games, sum, mean, best, accuracy; what there is not is empty.
std::vector<std::string> RankingTexts(const RankedMember& member, const StringTable& strings);
