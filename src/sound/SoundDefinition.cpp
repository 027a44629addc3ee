#include "sound/SoundDefinition.h"

#include <cstring>
#include <pugixml.hpp>

#include "core/text/Xml.h"

namespace {

bool IsElement(const pugi::xml_node& node, const char* name) {
  return node.type() == pugi::node_element && std::strcmp(node.name(), name) == 0;
}

/// Walks the elements below a node in document order. Not recursive: a file may nest as deep as it likes.
class Walk {
 public:
  explicit Walk(const pugi::xml_node& top) : top_(top), node_(top) {}

  const pugi::xml_node& Node() const { return node_; }
  /// Number of elements "sounds" around the present node, below the top.
  int InSounds() const { return inSounds_; }

  /// False at the end.
  bool Next() {
    if (node_.first_child()) {
      inSounds_ += node_ != top_ && IsElement(node_, "sounds") ? 1 : 0;
      node_ = node_.first_child();
      return true;
    }
    while (node_ != top_ && !node_.next_sibling()) {
      node_ = node_.parent();
      inSounds_ -= node_ != top_ && IsElement(node_, "sounds") ? 1 : 0;
    }
    if (node_ == top_) {
      return false;
    }
    node_ = node_.next_sibling();
    return true;
  }

 private:
  const pugi::xml_node top_;
  pugi::xml_node node_;
  int inSounds_ = 0;
};

pugi::xml_node FindBelow(const pugi::xml_node& top, const char* name) {
  for (Walk walk(top); walk.Next();) {
    if (IsElement(walk.Node(), name)) {
      return walk.Node();
    }
  }
  return {};
}

}  // namespace

std::optional<std::vector<std::string>> ReadSoundDefinition(std::string bytes) {
  pugi::xml_document document;
  if (!ParseXml(bytes, document)) {
    return std::nullopt;
  }
  const pugi::xml_node list = FindBelow(document.child("sound_defintions"), "sound_list_definition");
  if (!list) {
    return std::nullopt;
  }
  std::vector<std::string> events;
  for (Walk walk(list); walk.Next();) {
    if (walk.InSounds() > 0 && IsElement(walk.Node(), "sound_entry")) {
      events.push_back(GetChildText(walk.Node(), "name", "0"));
    }
  }
  return events;
}
