#pragma once

#include "platform/WordProcessor.h"

/// Starts the word processor and tracks it until it is ready or has failed.
class WordProcessorStart {
 public:
  explicit WordProcessorStart(WordProcessor& wordProcessor) : wordProcessor_(wordProcessor) {}

  /// The word processor's state; the first call starts it. Ended if it cannot be started.
  WordState Follow();

 private:
  WordProcessor& wordProcessor_;
  bool started_ = false;
};
