#pragma once

#include "firmware/pic24f/tool/ToolOptions.h"
#include "firmware/pic24f/tool/ToolParts.h"

/// A HEX file that was imported.
struct ImportedHex {
  std::int16_t Code;  ///< HexCode; Good if the images are there
  std::vector<LostStretch> Warnings;
};

/// Imports a file into images. On failure says why on the standard error; no image is left.
ImportedHex ImportHex(const ToolParts& parts, const std::string& file, const ImagePaths& images);

/// The commands that need no device. Each returns the exit code.
int RunCheck(const ToolParts& parts, const ToolOptions& options);
int RunImport(const ToolParts& parts, const ToolOptions& options);
int RunImage(const ToolParts& parts, const ToolOptions& options);
