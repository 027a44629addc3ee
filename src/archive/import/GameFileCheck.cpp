#include "archive/import/GameFileCheck.h"

#include <algorithm>
#include <cstring>
#include <pugixml.hpp>
#include <sstream>
#include <string_view>

#include "archive/PastGame.h"
#include "core/gamefile/GameFile.h"
#include "core/text/Filled.h"
#include "core/text/Pieces.h"
#include "core/text/TextEncoding.h"
#include "core/text/Xml.h"
#include "platform/RuntimeError.h"

namespace {

std::size_t LineAt(std::string_view bytes, std::ptrdiff_t offset) {
  const auto end = std::min(bytes.size(), static_cast<std::size_t>(std::max<std::ptrdiff_t>(offset, 0)));
  return static_cast<std::size_t>(
             std::count(bytes.begin(), bytes.begin() + static_cast<std::ptrdiff_t>(end), '\n')) +
         1;
}

std::size_t LineOf(pugi::xml_node node, std::string_view bytes) {
  return LineAt(bytes, node.offset_debug());
}

std::string MarkupOf(pugi::xml_node node) {
  std::ostringstream text;
  node.print(text, "", pugi::format_raw);
  return text.str();
}

/// The element with its text, short enough for a list: "ShotCount: many".
std::string Shown(pugi::xml_node element) {
  constexpr std::size_t most = 60;
  std::string shown = element.name();
  if (const std::string_view text = element.child_value(); !text.empty()) {
    shown.append(": ").append(FirstBytes(text, most));
  }
  return IsUtf8(shown) ? shown : Windows1252ToUtf8(shown);
}

GameFileFault FaultOf(int number) {
  switch (number) {
    case Fault::Overflow:
      return GameFileFault::NumberTooLarge;
    case Fault::SubscriptOutOfRange:
      return GameFileFault::NoSuchPlace;
    default:
      return GameFileFault::NoNumber;
  }
}

/// Finds the element that a game file's reader stumbles over, by giving it ever smaller parts of the file.
class Stumble {
 public:
  Stumble(const std::string& bytes, const StringTable& strings, const Breath& breathe)
      : bytes_(bytes), strings_(strings), breathe_(breathe) {}

  GameFileTrouble In(pugi::xml_node root) {
    if (const auto fault = FaultIn("", MarkupOf(root.child("GameHeader")))) {
      return InHeader(root.child("GameHeader"), *fault);
    }
    for (const pugi::xml_node players : root.children("PlayerData")) {
      for (const pugi::xml_node player : players.children("Player")) {
        breathe_();
        if (const auto fault = FaultOfPlayer(MarkupOf(player))) {
          return InPlayer(player, *fault);
        }
      }
    }
    return {.Fault = GameFileFault::NotXml, .Line = LineOf(root, bytes_)};
  }

 private:
  GameFileTrouble Found(GameFileFault fault, pugi::xml_node element) const {
    return {.Fault = fault, .Line = LineOf(element, bytes_), .What = Shown(element)};
  }

  std::optional<GameFileFault> FaultIn(const std::string& players, const std::string& header) const {
    Game game(strings_);
    try {
      ReadGameFile("<GameData>" + header + "<PlayerData>" + players + "</PlayerData></GameData>", game,
                   [](const std::string&) {});
    } catch (const RuntimeError& error) {
      return FaultOf(error.Number());
    }
    return std::nullopt;
  }
  std::optional<GameFileFault> FaultOfPlayer(const std::string& player) const { return FaultIn(player, ""); }

  GameFileTrouble InHeader(pugi::xml_node header, GameFileFault fault) const {
    int place = 0;
    for (const pugi::xml_node team : header.children("Team")) {
      const auto found = FaultIn("", "<GameHeader>" + MarkupOf(team) + "</GameHeader>");
      if (found || ++place > TeamCount) {
        return Found(found.value_or(fault), team);
      }
    }
    return Found(fault, header);
  }

  GameFileTrouble InPlayer(pugi::xml_node player, GameFileFault fault) const {
    const std::string index = MarkupOf(player.child("Index"));
    const auto faultWith = [&](const std::string& markup) {
      return FaultOfPlayer("<Player>" + index + markup + "</Player>");
    };
    if (const auto found = faultWith("")) {
      return Found(*found, player.child("Index") ? player.child("Index") : player);
    }
    for (const pugi::xml_node part : player.children()) {
      if (std::strcmp(part.name(), "Index") == 0) {
        continue;
      }
      const auto found = faultWith(MarkupOf(part));
      if (!found) {
        continue;
      }
      const pugi::xml_node hit = part.find_node([&](pugi::xml_node node) {
        return std::strcmp(node.name(), "HitByPlayer") == 0 &&
               faultWith("<HitData>" + MarkupOf(node) + "</HitData>");
      });
      return Found(*found, hit ? hit : part);
    }
    return Found(fault, player);
  }

  const std::string& bytes_;
  const StringTable& strings_;
  const Breath& breathe_;
};

/// What keeps the bytes from being the XML of a game.
GameFileTrouble TroubleOfXml(const std::string& bytes, const StringTable& strings, const Breath& breathe) {
  pugi::xml_document document;
  const pugi::xml_parse_result result = document.load_buffer(
      bytes.data(), bytes.size(), pugi::parse_default | pugi::parse_fragment, pugi::encoding_utf8);
  if (!result) {
    return {.Fault = GameFileFault::NotXml, .Line = LineAt(bytes, result.offset)};
  }
  std::string copy = bytes;
  pugi::xml_document strict;
  if (!ParseXml(copy, strict)) {  // text beside the root, a second one, a byte that is none
    const pugi::xml_node root = document.first_child();
    return {.Fault = GameFileFault::NotXml,
            .Line = LineOf(root.next_sibling() ? root.next_sibling() : root, bytes)};
  }
  const pugi::xml_node root = document.child("GameData");
  if (!root) {
    return {.Fault = GameFileFault::OtherKind,
            .Line = LineOf(document.first_child(), bytes),
            .What = Shown(document.first_child())};
  }
  return Stumble(bytes, strings, breathe).In(root);
}

}  // namespace

std::optional<GameFileTrouble> ReadCheckedGame(const std::string& bytes, const StringTable& strings,
                                               GameInFile& game, const Breath& breathe) {
  bool isGame = false;
  try {
    isGame = ReadGameFile(bytes, game.Game, [&game](const std::string& mission) { game.Mission = mission; });
  } catch (const RuntimeError&) {
    isGame = false;
  }
  breathe();
  if (!isGame) {
    return TroubleOfXml(bytes, strings, breathe);
  }
  if (std::none_of(game.Game.Players.begin(), game.Game.Players.end(),
                   [](const Player& player) { return player.Active; })) {
    return GameFileTrouble{.Fault = GameFileFault::NoPlayers};
  }
  try {
    CompleteScores(game.Game);
  } catch (const RuntimeError&) {
    return GameFileTrouble{.Fault = GameFileFault::SumTooLarge};
  }
  return std::nullopt;
}

std::string TextOf(const GameFileTrouble& trouble, const StringTable& strings) {
  const std::vector<std::string> texts = PartsOf(strings.Text(OwnText::GameFileFaults), '|');
  return Filled(texts.at(static_cast<std::size_t>(trouble.Fault)), {trouble.What});
}
