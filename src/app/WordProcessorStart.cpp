#include "app/WordProcessorStart.h"

#include <utility>

#include "platform/RuntimeError.h"

WordState WordProcessorStart::Follow() {
  try {
    if (!std::exchange(started_, true)) {
      wordProcessor_.Start();
    }
    return wordProcessor_.State();
  } catch (const RuntimeError&) {
    return WordState::Ended;
  }
}
