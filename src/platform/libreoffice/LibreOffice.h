#pragma once

#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "platform/WordProcessor.h"
#include "platform/linux/ChildProcess.h"
#include "platform/linux/KeptProgram.h"

class OfficeClient;

/// LibreOffice Writer as the word processor, with a profile of its own, so that it never disturbs the
/// operator's. Its libraries are not loaded before the first start. The process runs under a small host
/// program, which kills it and cleans up when this program ends, however that happens.
class LibreOffice : public WordProcessor {
 public:
  /// `folder` holds the module and the host program, which are used as they are now, whatever replaces them.
  explicit LibreOffice(const std::string& folder);
  ~LibreOffice() override;

  void Start() override;
  WordState State() override;
  std::unique_ptr<WordDocument> Add(const std::string& path) override;
  void JoinPdfs(const std::vector<std::string>& parts, const std::string& target,
                const std::function<void()>& onProgress) override;
  void Quit() noexcept override;

 private:
  void LoadModule();
  void StartHost();
  /// True while the host runs. Once it has ended, resets what belongs to it.
  bool HostRuns();
  void ForgetHost();

  KeptProgram module_;
  KeptProgram hostProgram_;
  std::unique_ptr<OfficeClient> client_;
  std::string pipe_;  ///< name on which LibreOffice listens
  std::optional<ChildProcess> host_;
  Descriptor leash_;  ///< the host ends when this is closed
  bool ready_ = false;
};
