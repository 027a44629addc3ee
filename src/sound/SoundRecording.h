#pragma once

#include <cstdint>
#include <string>
#include <vector>

#include "platform/Files.h"
#include "sound/PageIndexTable.h"
#include "sound/RecorderLink.h"
#include "sound/SoundList.h"
#include "sound/WaveFile.h"

/// One recording: erases the chip, sends the table of pages where the hardware needs it, and each sound page
/// by page. Nothing is retried: after one lost acknowledgement the chip must be recorded anew.
class SoundRecording {
 public:
  /// What a recording works with; all of it must outlive it.
  struct Parts {
    RecorderLink& Link;
    const SoundList& List;
    ::PageIndexTable& PageIndexTable;  ///< built by the caller
    const Files& Disk;
    WaveFile& Wave;
    RecorderDisplay& Display;
  };

  explicit SoundRecording(const Parts& parts) : parts_(parts) {}

  /// Runs the conversation on the open line. When the hardware does not answer the commands before the first
  /// sound, the line stays open; else it is closed. Throws RuntimeError 9 for a sound of no pages, 6 for one
  /// of more than 32,767, 53 or 75 for a file that cannot be read.
  void Record();

 private:
  bool Start();
  bool Erase();
  void SendPageIndexes();
  bool SendSounds();
  bool ProgramFile(const std::string& path, std::int16_t soundNumber);
  bool SendHeader(std::int16_t soundNumber);
  bool SendPage(RecorderLink::Data page);
  void AddPage();
  bool Idle();

  const Parts parts_;
  std::int16_t currentPage_ = 0;  ///< the chip's page that the next one is sent for
};

/// Plays each sound of the chip in turn, row by row, with a file or not, until one is not acknowledged.
void TestSounds(RecorderLink& link, const SoundList& list, RecorderDisplay& display);
