#pragma once

#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

#include "platform/Files.h"
#include "platform/MessageBoxes.h"

/// Paths of the three memory images.
struct ImagePaths {
  std::string ProgMem;
  std::string EeData;
  std::string Config;
};

/// The data of a HEX file by memory, as lines of images in the order of its records.
struct HexData {
  std::vector<std::string> ProgMem;  ///< without line ends
  std::string EeData;                ///< each line with its line end
  std::string Config;
};

/// Divides the text of a checked HEX file among the memories by the upper part of the address. Data of any
/// other upper part is left out. Throws RuntimeError 13 for an upper part that is no number.
HexData DivideHexText(std::string_view text);

/// Imports a HEX file: checks it, divides it, sorts and pads the program image and writes all three images
/// over old ones. Returns HexCode::Good, or the negative code of the check after a box that shows it; the
/// images are then untouched.
///
/// Throws RuntimeError if the file cannot be read or an image not be written, and as PaddedImage does. No
/// image is left then.
std::int16_t ImportHexFile(Files& files, MessageBoxes& boxes, const std::string& path,
                           const ImagePaths& images);

/// Deletes the images that are there. Throws RuntimeError 70 or 75.
void DeleteImages(Files& files, const ImagePaths& images);
