#include <string_view>
#include <utility>

#include "core/gamefile/GameFile.h"
#include "core/text/NumberForms.h"

namespace {

/// Builds the file's text: leaves indented, each on its own line; containers without any white space around
/// their tags.
class TreeWriter {
 public:
  std::string Bytes;

  void Open(std::string_view container) { Append({"<", container, ">"}); }
  void Close(std::string_view container) { Append({"</", container, ">"}); }

  void AddElement(std::string_view name, std::string_view value) {
    Append({"    <", name, ">"});
    AppendEscaped(value);
    Append({"</", name, ">\r\n"});
  }
  void AddElement(std::string_view name, std::int32_t value) { AddElement(name, Str(value)); }
  void AddFlag(std::string_view name, bool value) { AddElement(name, value ? "1" : "0"); }

 private:
  void Append(std::initializer_list<std::string_view> parts) {
    for (const std::string_view part : parts) {
      Bytes += part;
    }
  }

  void AppendEscaped(std::string_view text) {
    constexpr std::string_view reserved = "<>&\r";
    for (;;) {
      const std::size_t plain = text.find_first_of(reserved);
      Bytes += text.substr(0, plain);
      if (plain == std::string_view::npos) {
        return;
      }
      switch (text[plain]) {
        case '<':
          Bytes += "&lt;";
          break;
        case '>':
          Bytes += "&gt;";
          break;
        case '&':
          Bytes += "&amp;";
          break;
        default:
          Bytes += "&#13;";
          break;  // XML readers turn a literal carriage return into a line feed
      }
      text.remove_prefix(plain + 1);
    }
  }
};

void AddHeader(TreeWriter& tree, const Game& game, const std::string& missionName) {
  tree.Open("GameHeader");
  tree.AddElement("MissionName", missionName);
  for (const ObjectiveTeam& objective : game.ObjectiveTeams) {
    tree.Open("Team");
    tree.AddFlag("PrimaryObjectiveAchieved", objective.PrimaryAchieved);
    tree.AddFlag("SecondryObjectiveAchieved", objective.SecondaryAchieved);
    tree.AddElement("Name", objective.Name);
    tree.Close("Team");
  }
  tree.AddElement("GameDate", game.GameDate);
  tree.Close("GameHeader");
}

/// The beginning of each shooter's element in a list of hits, which is the same in all of them.
OneBased<std::string, PlayerCount> HitBeginnings(const OneBased<std::string, PlayerCount>& names) {
  OneBased<std::string, PlayerCount> beginnings;
  for (int shooter = 1; shooter <= PlayerCount; ++shooter) {
    TreeWriter hit;
    hit.Open("HitByPlayer");
    hit.AddElement("Index", std::int32_t{shooter});
    hit.AddElement("PlayerID", names(shooter));
    beginnings(shooter) = std::move(hit.Bytes);
  }
  return beginnings;
}

void AddHits(TreeWriter& tree, const Player& player, const OneBased<std::string, PlayerCount>& beginnings) {
  tree.Open("HitData");
  for (int shooter = 1; shooter <= PlayerCount; ++shooter) {
    const std::int32_t amount = player.HitByPlayer(shooter);
    if (amount > 0) {
      tree.Bytes += beginnings(shooter);
      tree.AddElement("Amount", amount);
      tree.Close("HitByPlayer");
    }
  }
  tree.Close("HitData");
}

void AddFields(TreeWriter& tree, const Player& player) {
  tree.AddElement("ShotCount", player.ShotCount);
  tree.AddElement("TotalDamage", player.TotalDamage);
  tree.AddElement("TotalDamage", player.TotalDamage);
  tree.AddElement("Soldiering", player.Soldiering);
  tree.AddElement("HealCount", player.HealCount);
  tree.AddElement("AmmoAddCount", player.AmmoAddCount);
  tree.AddElement("AdminKillCount", player.AdminKillCount);
  tree.AddElement("RespawnCount", player.RespawnCount);
  tree.AddElement("DeathCount", player.DeathCount);
  tree.AddElement("RunCounter", player.RunCounter);
  tree.AddFlag("Active", player.Active);
  tree.AddFlag("Committed", player.Committed);
  tree.AddElement("RemainingHealth", player.RemainingHealth);
  tree.AddElement("RemainingClips", player.RemainingClips);
  tree.AddElement("RemainingAmmo", player.RemainingAmmo);
  tree.AddElement("SecondaryDamage", player.SecondaryDamage);
  tree.AddElement("PrimaryDamage", player.PrimaryDamage);
  tree.AddElement("Accuracy", Str(player.Accuracy));
  tree.AddElement("Rank", std::int32_t{player.Rank});
  tree.AddElement("MemberIndex", player.MemberIndex);
  tree.AddElement("DallasID", player.DallasID);
  tree.AddElement("ExplosiveDamage", player.ExplosiveDamage);
  tree.AddElement("RadiationDamage", player.RadiationDamage);
  tree.AddElement("StunCount", player.StunCount);
  tree.AddElement("PowerCheatFlag", std::int32_t{player.PowerCheatFlag});
  tree.AddElement("BonusPoints", player.BonusPoints);
}

}  // namespace

std::string WriteGameFile(const Game& game, const std::string& missionName) {
  std::string bytes;
  WriteGameFile(game, missionName, [&bytes](std::string_view piece) { bytes += piece; });
  return bytes;
}

void WriteGameFile(const Game& game, const std::string& missionName,
                   const std::function<void(std::string_view piece)>& write) {
  OneBased<std::string, PlayerCount> names;
  for (int index = 1; index <= PlayerCount; ++index) {
    names(index) = game.DisplayName(index);
  }
  const OneBased<std::string, PlayerCount> hits = HitBeginnings(names);
  TreeWriter tree;
  const auto pass = [&] {
    write(tree.Bytes);
    tree.Bytes.clear();
  };
  tree.Open("GameData");
  AddHeader(tree, game, missionName);
  tree.Open("PlayerData");
  for (int index = 1; index <= PlayerCount; ++index) {
    const Player& player = game.Players(index);
    if (player.Active) {
      tree.Open("Player");
      tree.AddElement("Index", std::int32_t{index});
      tree.AddElement("PlayerID", names(index));
      AddHits(tree, player, hits);
      AddFields(tree, player);
      tree.Close("Player");
      pass();
    }
  }
  tree.Close("PlayerData");
  tree.Close("GameData");
  pass();
}
