#pragma once

#include <functional>
#include <map>
#include <string>

#include "exports/ExportedGame.h"
#include "exports/GameExport.h"
#include "exports/GameJson.h"
#include "exports/GamePage.h"

/// Hands over game after game.
using ExportedGames = std::function<void(const std::function<void(const ExportedGame&)>& take)>;

/// All that a writer makes of the games.
inline std::string Written(const ExportedGames& games, GameWriter& writer) {
  games([&writer](const ExportedGame& game) { writer.Add(game); });
  writer.End();
  return writer.Take();
}

inline std::string ExportBytes(const ExportedGames& games, const ExportChoice& choice,
                               const StringTable& strings) {
  return Written(games, *MakeGameWriter(choice, strings));
}

inline std::string PlayersTable(const ExportedGames& games, const CsvForm& form,
                                const PersonalData& personal) {
  PlayersCsv writer(form, personal);
  return Written(games, writer);
}

inline std::string HitsTable(const ExportedGames& games, const CsvForm& form) {
  HitsCsv writer(form);
  return Written(games, writer);
}

inline std::string JsonText(const ExportedGames& games, const PersonalData& personal) {
  GamesJson writer(personal);
  return Written(games, writer);
}

inline std::string PageText(const ExportedGames& games, const PersonalData& personal,
                            const StringTable& strings) {
  GamesPage writer(personal, strings);
  return Written(games, writer);
}

/// A game of three players with known hits: Blue 7, who is the member Mole, before Red 0 and Yellow 3. Blue 7
/// also hit Red 9, who took no part.
class SampleGame {
 public:
  static constexpr int Red0 = 1;
  static constexpr int Red9 = 10;
  static constexpr int Blue7 = 40;
  static constexpr int Yellow3 = 68;
  static constexpr std::int32_t Mole = 5;

  explicit SampleGame(Language language = Language::English) : Strings(language), Game(Strings) {
    Game.GameDate = "21/11/2026 20:15";
    Game.DataPresent = true;
    Game.ObjectiveTeams(2).PrimaryAchieved = true;
    AddPlayer(Red0, {.Soldiering = 70, .Rank = 2, .Shots = 8, .Damage = 30});
    AddPlayer(Blue7, {.Soldiering = 290, .Rank = 11, .Shots = 60, .Damage = 100});
    AddPlayer(Yellow3, {.Soldiering = -4, .Rank = 3, .Shots = 0, .Damage = 0});
    Game.Players(Red0).HitByPlayer(Blue7) = 40;
    Game.Players(Yellow3).HitByPlayer(Blue7) = 50;
    Game.Players(Red9).HitByPlayer(Blue7) = 10;
    Game.Players(Blue7).HitByPlayer(Red0) = 30;
    Game.Players(Red0).Accuracy = 0.375F;
    Game.Players(Blue7).Accuracy = 0.1F;
    Player& mole = Game.Players(Blue7);
    mole.MemberIndex = Mole;
    mole.DallasID = "0123456789ABCDEF";
    mole.Committed = true;
    mole.PowerCheatFlag = 255;
    for (const int team : {1, 2, 3}) {
      Game.TeamTotals(team) = std::map<int, int>{{1, 70}, {2, 290}, {3, -4}}[team];
    }
  }

  /// As it is now.
  ExportedGame Exported() const {
    return {.Game = Game,
            .Received = "2026-11-21 20:15:09",
            .Mission = Mission,
            .Standings = Standings(Game,
                                   [this](std::int32_t contactId) {
                                     const auto found = NickNames.find(contactId);
                                     return found == NickNames.end() ? std::string() : found->second;
                                   }),
            .FullNameOf = [this](std::int32_t contactId) {
              const auto found = FullNames.find(contactId);
              return found == FullNames.end() ? FullName() : found->second;
            }};
  }

  /// The same game that many times.
  ExportedGames Games(int count = 1) const {
    return [this, count](const std::function<void(const ExportedGame&)>& take) {
      for (int i = 0; i < count; ++i) {
        take(Exported());
      }
    };
  }

  StringTable Strings;
  ::Game Game;
  std::string Mission = "The Night Courier";
  std::map<std::int32_t, std::string> NickNames = {{Mole, "Mole"}};
  std::map<std::int32_t, FullName> FullNames = {{Mole, {"Ada", "Byron"}}};

 private:
  struct Figures {
    std::int32_t Soldiering;
    std::int16_t Rank;
    std::int32_t Shots;
    std::int32_t Damage;
  };

  void AddPlayer(int index, const Figures& figures) {
    Player& player = Game.Players(index);
    player.Active = true;
    player.Soldiering = figures.Soldiering;
    player.Rank = figures.Rank;
    player.ShotCount = figures.Shots;
    player.TotalDamage = figures.Damage;
    player.AbsoluteDamage = figures.Damage;
    player.PrimaryDamage = 10;
  }
};

/// All that can be ticked.
inline constexpr PersonalData EverythingPersonal{.FullNames = true, .MemberNumbers = true, .Buttons = true};

/// Names that a careless writer would break.
inline const std::string OddNames[] = {"<script>alert('1')</script>",
                                       "Tom & \"Jerry\"; </td>",
                                       "=HYPERLINK(\"x\")",
                                       "'+1",
                                       "a,b;c\td\r\ne",
                                       std::string("\xE2\x80\xAE").append("abc\xE2\x81\xA6"),
                                       "\x01\x7F\xEF\xBF\xBE\xF0\x9F\x98\x80",
                                       std::string(10000, 'x')};
