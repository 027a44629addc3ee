#pragma once

#include <algorithm>
#include <deque>
#include <functional>
#include <map>
#include <optional>
#include <string>
#include <vector>

#include "platform/PicBoot.h"
#include "platform/RuntimeError.h"

/// The library, with a device whose memories a test can look at. Program memory is kept by file address: two
/// bytes for each address of the device.
class FakePicBoot : public PicBoot {
 public:
  using Bytes = std::vector<std::uint8_t>;

  /// All operations in order, with their arguments: "OpenPIC COM 1 115200 1000", "SendGetPacket 0 2 up to 10,
  /// 3 retries", "WritePIC 2 at 80, 256 bytes in blocks of 256", "ErasePIC 0 43 5 retries".
  std::vector<std::string> Log;

  PicRecord Written;  ///< that of the last WritePIC

  /// What OpenPIC returns.
  std::int32_t Handle = 3;

  /// Answers to packets by their first byte; without one there is no answer, -2.
  std::map<std::uint8_t, Bytes> Answers = {
      {0, {0, 2, 5, 1}}, {1, {1, 2, 0, 0, 0, 0x00, 0x0C, 0x04, 0, 0xFE, 0xFF, 0xFF, 0}}, {8, {8}}};

  /// Identity at FF0000.
  std::uint16_t Identity = 1095;

  std::map<std::uint32_t, std::uint8_t> Flash;  ///< by file address; what is not there is erased
  std::map<std::uint32_t, std::uint8_t> Eeprom;

  /// Results of the next operations of this name, instead of what they do.
  std::map<std::string, std::deque<std::int32_t>> Results;

  /// The operation of this name throws.
  std::string Broken;
  int BrokenFault = Fault::PortLost;

  /// Called at the start of each operation, with its name.
  std::function<void(const std::string&)> OnCall;

  std::int32_t OpenPIC(const std::string& port, std::int32_t bitRate, std::int32_t timeOut) override {
    Begin("OpenPIC", port + ' ' + std::to_string(bitRate) + ' ' + std::to_string(timeOut));
    return Handle;
  }

  void ClosePIC(std::int32_t handle) override { Begin("ClosePIC", std::to_string(handle)); }

  void SendPacket(std::int32_t handle, std::span<const std::uint8_t> packet) override {
    Begin("SendPacket", std::to_string(handle) + TextOf(packet));
  }

  std::int32_t GetPacket(std::int32_t /*handle*/, std::span<std::uint8_t> /*buffer*/) override {
    Begin("GetPacket", "");
    return -2;
  }

  std::int32_t SendGetPacket(std::int32_t handle, std::span<std::uint8_t> buffer, std::size_t length,
                             std::size_t longest, std::int32_t retries) override {
    Begin("SendGetPacket", std::to_string(handle) + TextOf(buffer.first(length)) + " up to " +
                               std::to_string(longest) + ", " + std::to_string(retries) + " retries");
    if (const auto result = Told("SendGetPacket")) {
      return *result;
    }
    const auto answer = Answers.find(buffer[0]);
    if (answer == Answers.end()) {
      return -2;
    }
    std::copy(answer->second.begin(), answer->second.end(), buffer.begin());
    return static_cast<std::int32_t>(answer->second.size());
  }

  std::int32_t ReadPIC(std::int32_t handle, const PicRecord& record,
                       std::span<std::uint8_t> buffer) override {
    Begin("ReadPIC", std::to_string(handle) + TextOf(record));
    if (const auto result = Told("ReadPIC")) {
      return *result;
    }
    if (record.Address == 0xFF0000) {
      buffer[0] = static_cast<std::uint8_t>(Identity);
      buffer[1] = static_cast<std::uint8_t>(Identity >> 8U);
      return record.DataLength;
    }
    // EEPROM can be read at its byte address.
    const bool isEeprom = record.BytesPerAddress == 1;
    for (std::uint32_t i = 0; i < record.DataLength; ++i) {
      buffer[i] = isEeprom ? ByteOf(Eeprom, record.Address + i, 0xFF)
                           : ByteOf(Flash, record.Address * 2 + i, i % 4 == 3 ? 0 : 0xFF);
    }
    return record.DataLength;
  }

  std::int32_t WritePIC(std::int32_t handle, const PicRecord& record,
                        std::span<const std::uint8_t> bytes) override {
    Begin("WritePIC", std::to_string(handle) + TextOf(record));
    Written = record;
    if (const auto result = Told("WritePIC")) {
      return *result;
    }
    for (std::uint32_t i = 0; i < bytes.size(); ++i) {
      if (record.Command == 5) {
        Eeprom[record.Address + i] = bytes[i];
      } else {
        Flash[record.Address * 2 + i] = bytes[i];
      }
    }
    return 1;
  }

  std::int32_t VerifyPIC(std::int32_t /*handle*/, const PicRecord& /*record*/,
                         std::span<const std::uint8_t> /*bytes*/) override {
    Begin("VerifyPIC", "");
    return 1;
  }

  std::int32_t ErasePIC(std::int32_t handle, std::uint32_t address, std::int32_t blocks,
                        std::int32_t retries) override {
    Begin("ErasePIC", std::to_string(handle) + ", " + std::to_string(blocks) + " blocks from " +
                          std::to_string(address) + ", " + std::to_string(retries) + " retries");
    if (const auto result = Told("ErasePIC")) {
      return *result;
    }
    Flash.clear();
    return 1;
  }

 private:
  static std::uint8_t ByteOf(const std::map<std::uint32_t, std::uint8_t>& memory, std::uint32_t address,
                             int erased) {
    const auto found = memory.find(address);
    return found == memory.end() ? static_cast<std::uint8_t>(erased) : found->second;
  }

  static std::string TextOf(std::span<const std::uint8_t> packet) {
    std::string text = ":";
    for (const std::uint8_t byte : packet) {
      text += ' ' + std::to_string(byte);
    }
    return text;
  }

  static std::string TextOf(const PicRecord& record) {
    return ": " + std::to_string(record.Command) + " at " + std::to_string(record.Address) + ", " +
           std::to_string(record.DataLength) + " bytes in blocks of " + std::to_string(record.BlockSize) +
           ", " + std::to_string(record.MaxRetries) + " retries";
  }

  void Begin(const std::string& operation, const std::string& details) {
    Log.push_back(operation + (details.empty() ? "" : " " + details));
    if (const auto onCall = OnCall) {
      onCall(operation);
    }
    if (operation == Broken) {
      throw RuntimeError(BrokenFault);
    }
  }

  std::optional<std::int32_t> Told(const std::string& operation) {
    auto& results = Results[operation];
    if (results.empty()) {
      return std::nullopt;
    }
    const std::int32_t result = results.front();
    results.pop_front();
    return result;
  }
};
