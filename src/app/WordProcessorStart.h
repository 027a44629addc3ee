#pragma once

#include "platform/WordProcessor.h"

/// Starts the word processor and follows it until it is ready or will never be.
class WordProcessorStart {
 public:
  explicit WordProcessorStart(WordProcessor& wordProcessor) : wordProcessor_(wordProcessor) {}

  /// How far it has come; the first call starts it. One that cannot be started has ended.
  WordState Follow();

 private:
  WordProcessor& wordProcessor_;
  bool started_ = false;
};
