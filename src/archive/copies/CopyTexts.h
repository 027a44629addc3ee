#pragma once

#include <string>

#include "archive/copies/CopyWork.h"

/// Why a copy was made, in words.
std::string TextOf(CopyKind kind, const StringTable& strings);

/// What is being done, in words.
std::string TextOf(CopyStep step, const StringTable& strings);

/// How many rows a copy has more or fewer than the database has now, in words.
std::string DifferenceText(int rowsOfCopy, int rowsNow, const StringTable& strings);
