#include <pugixml.hpp>

#include "core/GameFile.h"
#include "core/NumberForms.h"

namespace {

constexpr const char* LeafIndent = "    ";

void AddText(pugi::xml_node parent, const char* text) {
  parent.append_child(pugi::node_pcdata).set_value(text);
}

/// Appends a leaf, indented, on a line of its own.
void AddElement(pugi::xml_node parent, const char* name, const std::string& value) {
  AddText(parent, LeafIndent);
  AddText(parent.append_child(name), value.c_str());
  AddText(parent, "\r\n");
}

void AddElement(pugi::xml_node parent, const char* name, std::int32_t value) {
  AddElement(parent, name, Str(value));
}

void AddElement(pugi::xml_node parent, const char* name, bool value) {
  AddElement(parent, name, std::string(value ? "1" : "0"));
}

void AddHeader(pugi::xml_node root, const Game& game, const std::string& missionName) {
  pugi::xml_node header = root.append_child("GameHeader");
  AddElement(header, "MissionName", missionName);
  for (const ObjectiveTeam& objective : game.ObjectiveTeams) {
    pugi::xml_node team = header.append_child("Team");
    AddElement(team, "PrimaryObjectiveAchieved", objective.PrimaryAchieved);
    AddElement(team, "SecondryObjectiveAchieved", objective.SecondaryAchieved);
    AddElement(team, "Name", objective.Name);
  }
  AddElement(header, "GameDate", game.GameDate);
}

void AddHits(pugi::xml_node parent, const Player& player, const OneBased<std::string, PlayerCount>& names) {
  pugi::xml_node hits = parent.append_child("HitData");
  for (int shooter = 1; shooter <= PlayerCount; ++shooter) {
    const std::int32_t amount = player.HitByPlayer(shooter);
    if (amount > 0) {
      pugi::xml_node hit = hits.append_child("HitByPlayer");
      AddElement(hit, "Index", std::int32_t{shooter});
      AddElement(hit, "PlayerID", names(shooter));
      AddElement(hit, "Amount", amount);
    }
  }
}

void AddFields(pugi::xml_node parent, const Player& player) {
  AddElement(parent, "ShotCount", player.ShotCount);
  AddElement(parent, "TotalDamage", player.TotalDamage);
  AddElement(parent, "TotalDamage", player.TotalDamage);
  AddElement(parent, "Soldiering", player.Soldiering);
  AddElement(parent, "HealCount", player.HealCount);
  AddElement(parent, "AmmoAddCount", player.AmmoAddCount);
  AddElement(parent, "AdminKillCount", player.AdminKillCount);
  AddElement(parent, "RespawnCount", player.RespawnCount);
  AddElement(parent, "DeathCount", player.DeathCount);
  AddElement(parent, "RunCounter", player.RunCounter);
  AddElement(parent, "Active", player.Active);
  AddElement(parent, "Committed", player.Committed);
  AddElement(parent, "RemainingHealth", player.RemainingHealth);
  AddElement(parent, "RemainingClips", player.RemainingClips);
  AddElement(parent, "RemainingAmmo", player.RemainingAmmo);
  AddElement(parent, "SecondaryDamage", player.SecondaryDamage);
  AddElement(parent, "PrimaryDamage", player.PrimaryDamage);
  AddElement(parent, "Accuracy", Str(player.Accuracy));
  AddElement(parent, "Rank", std::int32_t{player.Rank});
  AddElement(parent, "MemberIndex", player.MemberIndex);
  AddElement(parent, "DallasID", player.DallasID);
  AddElement(parent, "ExplosiveDamage", player.ExplosiveDamage);
  AddElement(parent, "RadiationDamage", player.RadiationDamage);
  AddElement(parent, "StunCount", player.StunCount);
  AddElement(parent, "PowerCheatFlag", std::int32_t{player.PowerCheatFlag});
  AddElement(parent, "BonusPoints", player.BonusPoints);
}

struct StringWriter : pugi::xml_writer {
  std::string Bytes;
  void write(const void* data, std::size_t size) override {
    Bytes.append(static_cast<const char*>(data), size);
  }
};

}  // namespace

std::string WriteGameFile(const Game& game, const std::string& missionName) {
  OneBased<std::string, PlayerCount> names;
  for (int index = 1; index <= PlayerCount; ++index) {
    names(index) = game.DisplayName(index);
  }
  pugi::xml_document document;
  pugi::xml_node root = document.append_child("GameData");
  AddHeader(root, game, missionName);
  pugi::xml_node players = root.append_child("PlayerData");
  for (int index = 1; index <= PlayerCount; ++index) {
    const Player& player = game.Players(index);
    if (player.Active) {
      pugi::xml_node node = players.append_child("Player");
      AddElement(node, "Index", std::int32_t{index});
      AddElement(node, "PlayerID", names(index));
      AddHits(node, player, names);
      AddFields(node, player);
    }
  }
  StringWriter writer;
  document.save(writer, "", pugi::format_raw | pugi::format_no_declaration, pugi::encoding_utf8);
  return std::move(writer.Bytes);
}
