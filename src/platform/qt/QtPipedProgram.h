#pragma once

#include <QPointer>
#include <QProcess>
#include <QTimer>

#include "platform/PipedProgram.h"
#include "platform/linux/KeptProgram.h"

/// Needs a QCoreApplication.
class QtPipedProgram final : public PipedProgram {
 public:
  /// Where the program of the name of `kept` is to be started, that one is. `kept` may be null, and must
  /// outlive this.
  explicit QtPipedProgram(const KeptProgram* kept = nullptr);
  ~QtPipedProgram() override;

  void Start(const std::vector<std::string>& words, std::chrono::milliseconds pause) override;
  void Write(std::string_view bytes) override;
  std::size_t Unread() const override;
  void Stop() override;

 private:
  void Launch();
  void Listen(QProcess& process);
  void HasEnded(int exitCode);

  const KeptProgram* kept_;
  QTimer pause_;
  std::vector<std::string> words_;
  QPointer<QProcess> process_;
};
