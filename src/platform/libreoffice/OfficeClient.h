#pragma once

#include <functional>
#include <memory>
#include <string>
#include <vector>

#include "platform/WordProcessor.h"

/// The conversation with one running LibreOffice, implemented by a module that is loaded at run time.
/// Everything that needs LibreOffice's own libraries lies behind this interface.
class OfficeClient {
 public:
  virtual ~OfficeClient() = default;

  /// LibreOffice's program folder, which holds soffice.bin.
  virtual std::string ProgramFolder() const = 0;

  /// Connects to the LibreOffice that listens on the pipe `name`. Returns false while nobody listens there.
  virtual bool Connect(const std::string& name) = 0;

  /// As in WordProcessor; needs the connection.
  virtual std::unique_ptr<WordDocument> Add(const std::string& path) = 0;

  virtual void JoinPdfs(const std::vector<std::string>& parts, const std::string& target,
                        const std::function<void()>& onProgress) = 0;

  /// Drops the connection without waiting for LibreOffice.
  virtual void Disconnect() noexcept = 0;
};

/// Name and type of the module's one function; the caller owns what it returns.
inline constexpr const char* NewOfficeClientName = "NewOfficeClient";
using NewOfficeClientFunction = OfficeClient*();
