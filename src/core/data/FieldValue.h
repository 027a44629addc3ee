#pragma once

#include <string>

#include "platform/Database.h"

/// A column's value as text: NULL is empty, numbers in plain decimals.
std::string TextOf(const Value& value);

/// A column's value as a number: NULL is 0. Throws RuntimeError 13 for a non-numeric text and for binary
/// data.
double NumberOf(const Value& value);
