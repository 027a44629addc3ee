#pragma once

#include <string>

#include "core/text/StringTable.h"

/// A poster for the hall on A4, as a PDF: the venue's name, which may be empty, the QR code of `url`, and
/// `url` in letters.
std::string ResultsPoster(const StringTable& strings, const std::string& venue, const std::string& url);
