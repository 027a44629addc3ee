#pragma once

#include "core/text/OwnTexts.h"

/// How a download ended after its line was open, except by a run-time failure.
enum class FirmwareEnd {
  Complete,
  ProgramCloses,  ///< silently
  NoLoadMode,     ///< stopped before a device announced itself
  Aborted,
  TimedOut,    ///< no reply within ten seconds
  LineFailed,  ///< already told to the operator
  WrongProduct,
  TooManyErrors,  ///< "c" answers while writing
  TooManyEraseErrors,
  InvalidLineAddress,  ///< "e" to a line of a QVM file
  InvalidRowAddress,
  InvalidPageAddress,
  InvalidReply,  ///< to a row
  InvalidEraseReply
};

/// How far a download came, as far as the device's program is concerned.
enum class FirmwareStage {
  Announcing,   ///< nothing was sent
  Identifying,  ///< the device is in its boot code, its program untouched
  Writing,
  Finishing  ///< all data was accepted
};

struct FirmwareEndTold {
  const char* Text;  ///< of the box; nullptr without one
  bool Resets;       ///< the window goes back to idle; otherwise only its Close button helps
};

FirmwareEndTold ToldOf(FirmwareEnd end);

/// What a download that failed at `stage` leaves behind, and what the operator can do about it.
OwnText AdviceFor(FirmwareStage stage);
