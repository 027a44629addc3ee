#include <algorithm>
#include <cstring>
#include <pugixml.hpp>
#include <string_view>
#include <vector>

#include "core/gamefile/GameFile.h"
#include "core/text/NumberForms.h"
#include "core/text/Xml.h"

namespace {

std::int32_t GetNumber(pugi::xml_node node, const char* name) {
  return ToInt32(GetChildText(node, name, "0"));
}

bool GetFlag(pugi::xml_node node, const char* name, const char* fallback) {
  return ToDouble(GetChildText(node, name, fallback)) == 1;
}

/// The "Player" elements of a file, as far as a plain text search can find them. The tree of a full game
/// takes several times the memory of its text, so players are parsed one by one where that gives the same
/// result.
std::vector<std::string_view> CutPlayers(std::string_view bytes) {
  constexpr std::string_view start = "<Player>";
  constexpr std::string_view end = "</Player>";
  std::vector<std::string_view> players;
  const std::size_t last = bytes.rfind(end);
  if (last == std::string_view::npos) {
    return players;
  }
  bytes = bytes.substr(0, last + end.size());
  for (std::size_t at = bytes.find(start); at != std::string_view::npos;) {
    const std::size_t next = bytes.find(start, at + 1);
    players.push_back(bytes.substr(at, next - at));
    at = next;
  }
  return players;
}

/// Parses one of the texts from CutPlayers, with `text` as work space.
bool ParsePlayer(std::string_view player, std::string& text, pugi::xml_document& document) {
  text = player;
  return ParseXml(text, document);
}

/// Parses the file without its players. Returns false unless parsing these one by one gives the same players
/// as the whole tree would.
bool ParseAround(std::string_view bytes, const std::vector<std::string_view>& players, std::string& text,
                 pugi::xml_document& document) {
  if (players.empty()) {
    return false;
  }
  const auto hole = static_cast<std::size_t>(players.front().data() - bytes.data());
  const auto end = static_cast<std::size_t>(players.back().data() - bytes.data()) + players.back().size();
  text.assign(bytes.substr(0, hole)).append("<Player/>").append(bytes.substr(end));
  if (!ParseXml(text, document)) {
    return false;
  }
  const pugi::xml_node root = document.child("GameData");
  const pugi::xml_node playerData = root.child("PlayerData");
  const pugi::xml_node standIn = playerData.child("Player");
  if (playerData.next_sibling("PlayerData") || standIn.next_sibling("Player") ||
      standIn.offset_debug() != static_cast<std::ptrdiff_t>(hole) + 1) {
    return false;
  }
  std::string work;
  pugi::xml_document player;
  return std::all_of(players.begin(), players.end(),
                     [&](std::string_view piece) { return ParsePlayer(piece, work, player); });
}

void ReadObjectiveTeams(pugi::xml_node header, Game& game) {
  int set = 0;
  for (const pugi::xml_node team : header.children("Team")) {
    ObjectiveTeam& objective = game.ObjectiveTeams(++set);
    objective.Name = GetChildText(team, "Name", "Error");
    objective.PrimaryAchieved = GetFlag(team, "PrimaryObjectiveAchieved", "Error");
    objective.SecondaryAchieved = GetFlag(team, "SecondryObjectiveAchieved", "Error");
  }
}

void ReadFields(pugi::xml_node node, Player& player) {
  player.ShotCount = GetNumber(node, "ShotCount");
  player.TotalDamage = GetNumber(node, "TotalDamage");
  player.AbsoluteDamage = GetNumber(node, "AbsoluteDamage");
  player.Soldiering = GetNumber(node, "Soldiering");
  player.HealCount = GetNumber(node, "HealCount");
  player.AmmoAddCount = GetNumber(node, "AmmoAddCount");
  player.AdminKillCount = GetNumber(node, "AdminKillCount");
  player.RespawnCount = GetNumber(node, "RespawnCount");
  player.DeathCount = GetNumber(node, "DeathCount");
  player.RunCounter = GetNumber(node, "RunCounter");
  player.Active = GetFlag(node, "Active", "0");
  player.Committed = GetFlag(node, "Committed", "0");
  player.RemainingHealth = GetNumber(node, "RemainingHealth");
  player.RemainingClips = GetNumber(node, "RemainingClips");
  player.RemainingAmmo = GetNumber(node, "RemainingAmmo");
  player.SecondaryDamage = GetNumber(node, "SecondaryDamage");
  player.PrimaryDamage = GetNumber(node, "PrimaryDamage");
  player.Accuracy = ToSingle(GetChildText(node, "Accuracy", "0"));
  player.Rank = ToInt16(GetChildText(node, "Rank", "0"));
  player.MemberIndex = GetNumber(node, "MemberIndex");
  player.DallasID = GetChildText(node, "DallasID", "0");
  player.ExplosiveDamage = GetNumber(node, "ExplosiveDamage");
  player.RadiationDamage = GetNumber(node, "RadiationDamage");
  player.StunCount = GetNumber(node, "StunCount");
  player.PowerCheatFlag = ToByte(GetChildText(node, "PowerCheatFlag", "0"));
  player.BonusPoints = GetNumber(node, "BonusPoints");
}

/// Reads the hits of every "HitData" element at any depth below a player.
struct HitReader : pugi::xml_tree_walker {
  explicit HitReader(Player& target) : Target(target) {}

  bool for_each(pugi::xml_node& node) override {
    if (node.type() == pugi::node_element && std::strcmp(node.name(), "HitByPlayer") == 0 &&
        std::strcmp(node.parent().name(), "HitData") == 0) {
      Target.HitByPlayer(GetNumber(node, "Index")) = GetNumber(node, "Amount");
    }
    return true;
  }

  Player& Target;
};

void ReadPlayer(pugi::xml_node node, Game& game) {
  Player& player = game.Players(GetNumber(node, "Index"));
  ReadFields(node, player);
  HitReader hits(player);
  node.traverse(hits);
}

}  // namespace

bool ReadGameFile(std::string bytes, Game& game,
                  const std::function<void(const std::string&)>& selectMission) {
  pugi::xml_document document;
  std::vector<std::string_view> players = CutPlayers(bytes);
  std::string around;
  if (!ParseAround(bytes, players, around, document)) {
    players.clear();
    if (!ParseXml(bytes, document)) {
      return false;
    }
  }
  const pugi::xml_node root = document.child("GameData");
  if (!root) {
    return false;
  }
  const pugi::xml_node header = root.child("GameHeader");
  selectMission(GetChildText(header, "MissionName", "None"));
  game.GameDate = GetChildText(header, "GameDate", "N/A");
  ReadObjectiveTeams(header, game);
  std::string text;
  pugi::xml_document piece;
  for (const std::string_view player : players) {
    ParsePlayer(player, text, piece);
    ReadPlayer(piece.child("Player"), game);
  }
  if (players.empty()) {
    for (const pugi::xml_node playerData : root.children("PlayerData")) {
      for (const pugi::xml_node player : playerData.children("Player")) {
        ReadPlayer(player, game);
      }
    }
  }
  return true;
}
