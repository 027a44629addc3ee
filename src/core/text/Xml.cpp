#include "core/text/Xml.h"

#include "core/text/TextEncoding.h"

namespace {

/// True for a document with one root element and no text beside it; a declaration may only come first, and a
/// document type only before the root.
bool IsWellFormed(const pugi::xml_document& document) {
  int elements = 0;
  int documentTypes = 0;
  for (const pugi::xml_node node : document.children()) {
    switch (node.type()) {
      case pugi::node_element:
        ++elements;
        break;
      case pugi::node_doctype:
        if (++documentTypes > 1 || elements > 0) {
          return false;
        }
        break;
      case pugi::node_declaration:
        if (node.previous_sibling()) {
          return false;
        }
        break;
      case pugi::node_pcdata:
      case pugi::node_cdata:
        return false;
      default:
        break;
    }
  }
  return elements == 1;
}

}  // namespace

bool ParseXml(std::string& bytes, pugi::xml_document& document) {
  // embed_pcdata keeps a leaf's text in its element: a hit takes 4 nodes instead of 7, and a game can hold
  // 50,176 hits.
  constexpr unsigned int options = pugi::parse_default | pugi::parse_declaration | pugi::parse_doctype |
                                   pugi::parse_ws_pcdata_single | pugi::parse_fragment |
                                   pugi::parse_embed_pcdata;
  const bool isWide = bytes.starts_with("\xFF\xFE") || bytes.starts_with("\xFE\xFF");
  if (!isWide && bytes.find('\0') != std::string::npos) {
    return false;
  }
  const auto encoding = isWide ? pugi::encoding_auto : pugi::encoding_utf8;
  return document.load_buffer_inplace(bytes.data(), bytes.size(), options, encoding) &&
         IsWellFormed(document);
}

std::string GetChildText(pugi::xml_node node, const char* name, const char* fallback) {
  const pugi::xml_node child = node.child(name);
  if (!child) {
    return fallback;
  }
  std::string text = child.value();
  for (const pugi::xml_node part : child.children()) {
    if (part.type() == pugi::node_pcdata || part.type() == pugi::node_cdata) {
      text += part.value();
    }
  }
  // Besides old encodings this repairs references such as "&#xD800;", whose bytes are not UTF-8 and would
  // spoil the next save.
  return IsUtf8(text) ? text : Windows1252ToUtf8(text);
}
