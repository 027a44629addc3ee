#pragma once

#include <string_view>

#include "firmware/files/FirmwareImage.h"
#include "platform/MessageBoxes.h"

/// Reads the text of a HEX file for a larger device into `image`, and copies its reset jump to where the boot
/// loader expects the one of the application. Returns false, after a box, for a program that would overwrite
/// the boot loader or has no reset jump. No record's checksum is looked at.
///
/// Throws RuntimeError 9 for an instruction beyond the image, 6 for one beyond number 32767 and for what is
/// no hexadecimal number of its size.
bool LoadHexImage(std::string_view text, FirmwareImage& image, MessageBoxes& boxes);
