#pragma once

#include <functional>
#include <memory>
#include <string>
#include <vector>

#include "platform/WordProcessor.h"

/// What the module that is loaded at run time does: the conversation with one running LibreOffice. Everything
/// that needs LibreOffice's own libraries lies behind this interface.
class OfficeClient {
 public:
  virtual ~OfficeClient() = default;

  /// Folder of LibreOffice's programs, with soffice.bin in it.
  virtual std::string ProgramFolder() const = 0;

  /// Connects to the LibreOffice that listens on the pipe `name`. Returns false while nobody listens there.
  virtual bool Connect(const std::string& name) = 0;

  /// As in WordProcessor; needs the connection.
  virtual std::unique_ptr<WordDocument> Add(const std::string& path) = 0;

  virtual void JoinPdfs(const std::vector<std::string>& parts, const std::string& target,
                        const std::function<void()>& onProgress) = 0;

  /// Lets go of the connected LibreOffice, without a word from it.
  virtual void Disconnect() noexcept = 0;
};

/// Name and type of the module's one function; the caller owns what it returns.
inline constexpr const char* NewOfficeClientName = "NewOfficeClient";
using NewOfficeClientFunction = OfficeClient*();
