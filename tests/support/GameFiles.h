#pragma once

#include <string>

/// A game file of these players for the named mission.
inline std::string GameFile(const std::string& players, const std::string& mission = "None") {
  return "<GameData><GameHeader><MissionName>" + mission +
         "</MissionName><GameDate>today</GameDate></GameHeader><PlayerData>" + players +
         "</PlayerData></GameData>";
}

/// An active player in a game file, with these further fields.
inline std::string PlayerOf(int index, const std::string& fields = {}) {
  return "<Player><Index>" + std::to_string(index) + "</Index><Active>1</Active>" + fields + "</Player>";
}

/// Red 0 with 5 points and Blue 7 with 9.
inline std::string SmallGame() {
  return GameFile(PlayerOf(1, "<BonusPoints>5</BonusPoints>") + PlayerOf(40, "<BonusPoints>9</BonusPoints>"));
}

/// Nine players who hit each other, none of them a member.
inline std::string GameOfManyHits() {
  std::string players;
  for (int index = 1; index <= 9; ++index) {
    std::string hits;
    for (int shooter = 1; shooter <= 9; ++shooter) {
      hits += "<HitByPlayer><Index>" + std::to_string(shooter * 20) + "</Index><Amount>" +
              std::to_string(7 + index * shooter * 13 % 90) + "</Amount></HitByPlayer>";
    }
    players +=
        PlayerOf(index * 20, "<HitData>" + hits +
                                 "</HitData><ShotCount>250</ShotCount><PrimaryDamage>10</PrimaryDamage>"
                                 "<RunCounter>125</RunCounter><ExplosiveDamage>12</ExplosiveDamage>");
  }
  return GameFile(players);
}
