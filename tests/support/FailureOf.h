#pragma once

#include "platform/RuntimeError.h"

/// Number of the RuntimeError that `command` throws, 0 if it throws none.
template <typename Command>
int FailureOf(Command&& command) {
  try {
    command();
  } catch (const RuntimeError& error) {
    return error.Number();
  }
  return 0;
}
