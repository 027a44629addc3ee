#pragma once

#include <string>

/// The three parts of an OpenDocument text in one XML file.
struct FlatDocumentParts {
  std::string AutomaticStyles = {};
  std::string MasterStyles = {};
  std::string Body;
};

inline std::string FlatDocument(const FlatDocumentParts& parts) {
  return R"(<?xml version="1.0" encoding="UTF-8"?><office:document
      xmlns:office="urn:oasis:names:tc:opendocument:xmlns:office:1.0"
      xmlns:text="urn:oasis:names:tc:opendocument:xmlns:text:1.0"
      xmlns:style="urn:oasis:names:tc:opendocument:xmlns:style:1.0"
      xmlns:table="urn:oasis:names:tc:opendocument:xmlns:table:1.0"
      xmlns:draw="urn:oasis:names:tc:opendocument:xmlns:drawing:1.0"
      xmlns:fo="urn:oasis:names:tc:opendocument:xmlns:xsl-fo-compatible:1.0"
      xmlns:svg="urn:oasis:names:tc:opendocument:xmlns:svg-compatible:1.0" office:version="1.3"
      office:mimetype="application/vnd.oasis.opendocument.text"><office:automatic-styles>)" +
         parts.AutomaticStyles + "</office:automatic-styles><office:master-styles>" + parts.MasterStyles +
         "</office:master-styles><office:body><office:text>" + parts.Body +
         "</office:text></office:body></office:document>";
}

/// A table of one column.
inline std::string FlatTable(int rows) {
  std::string text = "<table:table><table:table-column/>";
  for (int row = 0; row < rows; ++row) {
    text += "<table:table-row><table:table-cell><text:p/></table:table-cell></table:table-row>";
  }
  return text + "</table:table>";
}

/// A style of frames, of this name: how text wraps around the frame, and the distance it keeps from what is
/// in it.
inline std::string FrameStyle(const std::string& name, const std::string& wrap, const std::string& padding) {
  return "<style:style style:name='" + name +
         "' style:family='graphic' style:parent-style-name='Frame'><style:graphic-properties style:wrap='" +
         wrap + "' fo:padding='" + padding + "' fo:border='none'/></style:style>";
}

/// A frame of such a style in a paragraph of its own; `behind` follows it there.
inline std::string FlatFrame(const std::string& style, const std::string& anchor, const std::string& inside,
                             const std::string& behind = "") {
  return "<text:p><draw:frame draw:style-name='" + style + "' text:anchor-type='" + anchor +
         "' svg:width='5cm'><draw:text-box>" + inside + "</draw:text-box></draw:frame>" + behind +
         "</text:p>";
}
