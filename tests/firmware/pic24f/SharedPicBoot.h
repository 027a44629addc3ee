#pragma once

#include "platform/PicBoot.h"

/// Passes everything on: the window owns its library, and the test keeps looking at the fake.
class SharedPicBoot : public PicBoot {
 public:
  explicit SharedPicBoot(PicBoot& library) : library_(library) {}
  std::int32_t OpenPIC(const std::string& port, std::int32_t bitRate, std::int32_t timeOut) override {
    return library_.OpenPIC(port, bitRate, timeOut);
  }
  void ClosePIC(std::int32_t handle) override { library_.ClosePIC(handle); }
  void SendPacket(std::int32_t handle, std::span<const std::uint8_t> packet) override {
    library_.SendPacket(handle, packet);
  }
  std::int32_t GetPacket(std::int32_t handle, std::span<std::uint8_t> buffer) override {
    return library_.GetPacket(handle, buffer);
  }
  std::int32_t SendGetPacket(std::int32_t handle, std::span<std::uint8_t> buffer, std::size_t length,
                             std::size_t longest, std::int32_t retries) override {
    return library_.SendGetPacket(handle, buffer, length, longest, retries);
  }
  std::int32_t ReadPIC(std::int32_t handle, const PicRecord& record,
                       std::span<std::uint8_t> buffer) override {
    return library_.ReadPIC(handle, record, buffer);
  }
  std::int32_t WritePIC(std::int32_t handle, const PicRecord& record,
                        std::span<const std::uint8_t> bytes) override {
    return library_.WritePIC(handle, record, bytes);
  }
  std::int32_t VerifyPIC(std::int32_t handle, const PicRecord& record,
                         std::span<const std::uint8_t> bytes) override {
    return library_.VerifyPIC(handle, record, bytes);
  }
  std::int32_t ErasePIC(std::int32_t handle, std::uint32_t address, std::int32_t blocks,
                        std::int32_t retries) override {
    return library_.ErasePIC(handle, address, blocks, retries);
  }

 private:
  PicBoot& library_;
};
