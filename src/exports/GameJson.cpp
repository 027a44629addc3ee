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

/// A list whose objects stand one below the other, so that the file can be read and compared by lines.
class ListLines {
 public:
  /// Returns what stands before the next object.
  const char* Next() {
    const char* before = empty_ ? "[\n" : ",\n";
    empty_ = false;
    return before;
  }
  /// Returns what stands behind the last one.
  const char* End() const { return empty_ ? "[]" : "\n]"; }

 private:
  bool empty_ = true;
};

void AddGame(std::string& text, const ExportedGame& game, int number, const PersonalData& personal) {
  Json head = ObjectOf(HeadOf(game, number));
  AddTo(head, RestOf(game));
  std::string line = LineOf(head);
  line.pop_back();  // the brace: the lists belong to the same object
  text.append(line).append(",\n\"players\": ");
  ListLines players;
  for (const Standing& standing : game.Standings) {
    text.append(players.Next()).append(LineOf(ObjectOf(PlayerOf(game, standing, personal))));
  }
  text.append(players.End()).append(",\n\"hits\": ");
  ListLines hits;
  for (const ExportedHit& hit : HitsOf(game.Game)) {
    text.append(hits.Next()).append(LineOf(ObjectOf(HitOf(game, hit))));
  }
  text.append(hits.End()).append("}");
}

}  // namespace

GamesJson::GamesJson(const PersonalData& personal) : personal_(personal) {
  text_.append("{\"format\": ").append(LineOf(GameJsonFormat));
  text_.append(", \"version\": ").append(std::to_string(GameJsonVersion)).append(", \"games\": ");
}

void GamesJson::Add(const ExportedGame& game) {
  text_.append(number_ == 0 ? "[\n" : ",\n");
  AddGame(text_, game, ++number_, personal_);
}

void GamesJson::End() {
  text_.append(number_ == 0 ? "[]}\n" : "\n]}\n");
}

std::string GamesJson::Take() {
  return std::exchange(text_, {});
}
