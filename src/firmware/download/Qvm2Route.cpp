#include "firmware/download/Qvm2Route.h"

#include "firmware/download/FirmwarePackets.h"

namespace {

constexpr int MostErrors = 10;

/// What the status line counts for a row of 64 code words.
constexpr int CountOfARow = 8;

constexpr std::uint64_t WireBytesOfAPage = ErasePacketSize + FirmwareImage::RowsOfAPage * WritePacketSize;

}  // namespace

const Qvm2Route::PacketKind Qvm2Route::ErasesPage = {'b', FirmwareEnd::TooManyEraseErrors,
                                                     FirmwareEnd::InvalidPageAddress,
                                                     FirmwareEnd::InvalidEraseReply, "page "};
const Qvm2Route::PacketKind Qvm2Route::WritesRow = {
    'f', FirmwareEnd::TooManyErrors, FirmwareEnd::InvalidRowAddress, FirmwareEnd::InvalidReply, "row "};

DownloadStep Qvm2Route::Transfer(const FirmwareImage& image) {
  if (const DownloadStep end = Begin()) {
    return end;
  }
  display_.SetStatus("Sync'd");
  for (int page = 0; page < FirmwareImage::MostPages; ++page) {
    if (const DownloadStep end = line_.CheckAbort()) {
      return end;
    }
    if (!image.PageUsed.test(static_cast<std::size_t>(page))) {
      continue;
    }
    if (const DownloadStep end = SendPage(image, page)) {
      return end;
    }
  }
  stage_ = FirmwareStage::Finishing;
  return line_.Ask("F", "f");
}

DownloadStep Qvm2Route::Begin() {
  if (const DownloadStep end = line_.SendString("P")) {
    return end;
  }
  const DownloadReply product = line_.Await("dp", DownloadLine::First::Abort);
  if (product.End) {
    return product.End;
  }
  if (product.Character == 'p') {
    return FirmwareEnd::WrongProduct;
  }
  return line_.Ask("B", "s");
}

DownloadStep Qvm2Route::SendPage(const FirmwareImage& image, int page) {
  ++pagesDone_;
  stage_ = FirmwareStage::Writing;
  if (const DownloadStep end = SendPacket(ErasePacket(page), ErasesPage, page)) {
    return end;
  }
  const std::uint64_t all = WireBytesOfAPage * static_cast<std::uint64_t>(image.PageCount);
  std::uint64_t sent = WireBytesOfAPage * static_cast<std::uint64_t>(pagesDone_ - 1) + ErasePacketSize;
  for (int row = page * FirmwareImage::RowsOfAPage; row < (page + 1) * FirmwareImage::RowsOfAPage; ++row) {
    if (const DownloadStep end = line_.CheckAbort()) {
      return end;
    }
    const std::span<const std::uint8_t, FirmwareImage::RowBytes> bytes(
        image.ImageBuffer.data() + static_cast<std::size_t>(row) * FirmwareImage::RowBytes,
        FirmwareImage::RowBytes);
    if (const DownloadStep end = SendPacket(WritePacket(row, bytes), WritesRow, row)) {
      return end;
    }
    codeWords_ += CountOfARow;
    display_.SetStatus("Loaded " + std::to_string(codeWords_) + " code words");
    display_.SetBar(static_cast<double>(pagesDone_) / image.PageCount);
    sent += WritePacketSize;
    display_.SetSent(sent, all);
  }
  return std::nullopt;
}

DownloadStep Qvm2Route::SendPacket(std::span<const std::uint8_t> packet, const PacketKind& kind, int number) {
  for (;;) {
    line_.SendBytes(packet);
    const DownloadReply reply = line_.AwaitReply();
    if (reply.End) {
      return reply.End;
    }
    if (reply.Character == kind.Accepted) {
      return std::nullopt;
    }
    line_.NoteBadReply(kind.Name + std::to_string(number), reply.Character);
    if (reply.Character == 'e') {
      return kind.InvalidAddress;
    }
    if (reply.Character != 'c') {
      return kind.InvalidReply;
    }
    if (errorCount_ >= MostErrors) {
      return kind.TooManyErrors;
    }
    ++errorCount_;
  }
}
