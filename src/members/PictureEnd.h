#pragma once

#include <string_view>

/// True if `bytes`, a picture file of `format` ("jpeg", "gif" or "bmp"), break off before the end of the
/// picture, of the first one in a GIF. What follows that end, and sizes that only concern the file, do not
/// count. False for other formats and for compressed BMPs, whose length their header does not give.
bool IsCutShort(std::string_view bytes, std::string_view format);
