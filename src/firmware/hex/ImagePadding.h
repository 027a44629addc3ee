#pragma once

#include <string>
#include <vector>

#include "platform/Files.h"

/// Sorts the lines of a program image and pads them, so that they make up whole blocks of 16 lines. Each
/// block begins at a multiple of 256 addresses, and blocks that hold only fill are left out. Lines that do
/// not stand at multiples of 16 are joined to their neighbours by rules that suit halves of 8 bytes; others
/// come out damaged (ImageComparison finds that).
///
/// Returns the image. Throws RuntimeError 62 if there are no lines, 9 if the first one is not at address 0,
/// 13 for a line without an address.
std::string PaddedImage(std::vector<std::string> lines);

/// Sorts and pads the image file at `path`. Throws as PaddedImage and the file do; the file is then as it
/// was.
void PadProgramImage(Files& files, const std::string& path);
