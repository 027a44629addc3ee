#pragma once

#include <string>

#include "platform/RuntimeError.h"

struct Thrown {
  int Number = 0;
  std::string Text;
};

/// Number and text of the RuntimeError that `operation` throws; number 0 if it throws none.
template <typename Operation>
Thrown ThrownBy(Operation&& operation) {
  try {
    operation();
  } catch (const RuntimeError& error) {
    return {error.Number(), error.what()};
  }
  return {};
}

template <typename Operation>
int NumberThrownBy(Operation&& operation) {
  return ThrownBy(operation).Number;
}
