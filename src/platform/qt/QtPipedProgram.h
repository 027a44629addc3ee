#pragma once

#include <QPointer>
#include <QProcess>
#include <QTimer>

#include "platform/PipedProgram.h"

/// Needs a QCoreApplication.
class QtPipedProgram final : public PipedProgram {
 public:
  QtPipedProgram();
  ~QtPipedProgram() override;

  void Start(const std::vector<std::string>& words, std::chrono::milliseconds pause) override;
  void Write(std::string_view bytes) override;
  std::size_t Unread() const override;
  void Stop() override;

 private:
  void Launch();
  void Listen(QProcess& process);
  void HasEnded(int exitCode);

  QTimer pause_;
  std::vector<std::string> words_;
  QPointer<QProcess> process_;
};
