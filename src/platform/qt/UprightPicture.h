#pragma once

#include <string>

/// The picture file `bytes`, turned and mirrored as the camera noted in it (Exif orientation), for programs
/// that ignore that note. The same bytes if there is nothing to turn or they cannot be read. Keeps the
/// density that the picture tells; one that tells none is given 96 dots per inch.
std::string UprightPicture(const std::string& bytes);
