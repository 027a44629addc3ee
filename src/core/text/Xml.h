#pragma once

#include <pugixml.hpp>
#include <string>

/// Parses in place: the document points into `bytes`. Stricter than the parser itself: false also for a
/// document without exactly one root element, and for text beside the root.
bool ParseXml(std::string& bytes, pugi::xml_document& document);

/// Text of the first child element `name`, without comments, or `fallback` if there is none.
std::string GetChildText(pugi::xml_node node, const char* name, const char* fallback);
