#pragma once

#include <cstddef>
#include <cstdint>
#include <optional>
#include <string>
#include <vector>

#include "platform/Files.h"
#include "sound/WaveFile.h"

/// A sound event of the product, and the file that the operator gave it.
struct SoundRow {
  std::string Event;
  std::string File = {};  ///< full path; empty for none
  /// Pages that the file takes on the chip, as last reckoned; none without a usable file.
  std::optional<std::int32_t> Pages = {};
};

/// The rows of the window's list. A row's index, counted from 0, is the sound's number on the chip.
class SoundList {
 public:
  /// Both must outlive the list.
  SoundList(const Files& files, WaveFile& wave) : files_(files), wave_(wave) {}

  const std::vector<SoundRow>& Rows() const { return rows_; }

  /// New rows without files.
  void Fill(const std::vector<std::string>& events);

  /// Gives a row its file, without the blanks around the path. Throws RuntimeError 9 if there is no such row.
  void AddSoundToList(const std::string& path, std::size_t row);

  /// The paths of all rows as a play list.
  std::string Playlist() const;

  /// Gives the files of a play list to the rows from the first one on. An empty record is passed over and the
  /// row stays, so sounds after a hole move up; rows that the list does not reach keep their files. Throws
  /// RuntimeError 9 at the first record that finds no row.
  void TakePlaylist(const std::string& bytes);

  /// Reckons the pages of each row anew and returns the seconds that all sounds take. A wave file that is
  /// refused has its box and no pages. Throws RuntimeError 53 or 75 for raw samples that cannot be read.
  double Reckon();

 private:
  const Files& files_;
  WaveFile& wave_;
  std::vector<SoundRow> rows_;
};

/// "Sound Chip Utilisation: ..." for sounds of `seconds` together.
std::string UtilisationText(double seconds);
