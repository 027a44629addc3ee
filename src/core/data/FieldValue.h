#pragma once

#include <string>

#include "platform/Database.h"

/// A column's value as text: NULL is empty, numbers in plain decimals.
std::string TextOf(const Value& value);

/// A column's value as number: NULL is 0. Throws RuntimeError 13 for a text that is no number, or for bytes.
double NumberOf(const Value& value);
