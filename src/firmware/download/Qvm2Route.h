#pragma once

#include <span>
#include <string>
#include <string_view>

#include "firmware/download/DownloadLine.h"
#include "firmware/download/FirmwareDisplay.h"
#include "firmware/files/FirmwareImage.h"

/// The dialect of devices that take QVM2 files: each used page is erased, then all its eight rows are
/// written, whether or not the file lists them.
class Qvm2Route {
 public:
  /// All must outlive this object. `stage` follows how far the transfer came.
  Qvm2Route(DownloadLine& line, FirmwareDisplay& display, FirmwareStage& stage)
      : line_(line), display_(display), stage_(stage) {}

  /// From identification to the end, "F" included. Throws RuntimeError if the line fails.
  DownloadStep Transfer(const FirmwareImage& image);

 private:
  /// How a packet of one kind may end.
  struct PacketKind {
    char Accepted;
    FirmwareEnd TooManyErrors;
    FirmwareEnd InvalidAddress;
    FirmwareEnd InvalidReply;
    const char* Name;
  };

  DownloadStep Begin();
  DownloadStep SendPage(const FirmwareImage& image, int page);
  /// Sends a packet until it is accepted. `toWhat` names it in the record.
  DownloadStep SendPacket(std::span<const std::uint8_t> packet, const PacketKind& kind, int number);

  static const PacketKind ErasesPage;
  static const PacketKind WritesRow;

  DownloadLine& line_;
  FirmwareDisplay& display_;
  FirmwareStage& stage_;
  std::int32_t codeWords_ = 0;
  int pagesDone_ = 0;   ///< used pages that were reached
  int errorCount_ = 0;  ///< "c" answers of the whole transfer
};
