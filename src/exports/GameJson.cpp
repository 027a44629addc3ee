#include "exports/GameJson.h"

#include <nlohmann/json.hpp>
#include <utility>

#include "exports/ExportColumns.h"

namespace {

using Json = nlohmann::ordered_json;

Json JsonOf(const ExportValue& value) {
  return std::visit(
      [](const auto& held) -> Json {
        if constexpr (std::is_same_v<std::decay_t<decltype(held)>, std::monostate>) {
          return nullptr;
        } else {
          return held;
        }
      },
      value);
}

void AddTo(Json& object, const NamedValues& values) {
  for (const NamedValue& each : values) {
    object[each.Name] = JsonOf(each.Value);
  }
}

Json ObjectOf(const NamedValues& values) {
  Json object = Json::object();
  AddTo(object, values);
  return object;
}

std::string LineOf(const Json& value) {
  constexpr int compact = -1;
  return value.dump(compact);
}

/// Objects one below the other, so that the file can be read and compared by lines.
class JsonLines {
 public:
  explicit JsonLines(std::string& text) : text_(text) { text_.append("["); }

  void Begin() {
    text_.append(empty_ ? "\n" : ",\n");
    empty_ = false;
  }
  void Add(const NamedValues& values) {
    Begin();
    text_.append(LineOf(ObjectOf(values)));
  }
  void End() { text_.append(empty_ ? "]" : "\n]"); }

 private:
  std::string& text_;
  bool empty_ = true;
};

void AddGame(std::string& text, const ExportedGame& game, int number, const PersonalData& personal) {
  Json head = ObjectOf(HeadOf(game, number));
  AddTo(head, RestOf(game));
  std::string line = LineOf(head);
  line.pop_back();  // the brace: the lists belong to the same object
  text.append(line).append(",\n\"players\": ");
  JsonLines players(text);
  for (const Standing& standing : game.Standings) {
    players.Add(PlayerOf(game, standing, personal));
  }
  players.End();
  text.append(",\n\"hits\": ");
  JsonLines hits(text);
  for (const ExportedHit& hit : HitsOf(game.Game)) {
    hits.Add(HitOf(game, hit));
  }
  hits.End();
  text.append("}");
}

}  // namespace

std::string GamesJson(const ExportedGames& games, const PersonalData& personal) {
  std::string text = "{\"format\": ";
  text.append(LineOf(GameJsonFormat)).append(", \"version\": ").append(std::to_string(GameJsonVersion));
  text.append(", \"games\": ");
  JsonLines list(text);
  int number = 0;
  games([&](const ExportedGame& game) {
    list.Begin();
    AddGame(text, game, ++number, personal);
  });
  list.End();
  text.append("}\n");
  return text;
}
