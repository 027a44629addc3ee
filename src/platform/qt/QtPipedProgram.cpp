#include "platform/qt/QtPipedProgram.h"

#include <linux/close_range.h>
#include <unistd.h>

#include <QCoreApplication>

namespace {

/// Ends without a word where its owner ends while it still runs.
class OwnedProcess final : public QProcess {
 public:
  using QProcess::QProcess;
  ~OwnedProcess() override {
    disconnect();
    if (state() != NotRunning) {
      kill();
      waitForFinished();
    }
  }
};

/// Ends a process that nobody listens to any more, without waiting for its end.
void LeaveToItself(QProcess& process) {
  process.disconnect();
  if (process.state() == QProcess::NotRunning) {
    process.deleteLater();
    return;
  }
  QObject::connect(&process, &QProcess::finished, &process, &QObject::deleteLater);
  QObject::connect(&process, &QProcess::errorOccurred, &process, [&process](QProcess::ProcessError error) {
    if (error == QProcess::FailedToStart) {
      process.deleteLater();
    }
  });
  process.kill();
}

}  // namespace

QtPipedProgram::QtPipedProgram(const KeptProgram* kept) : kept_(kept) {
  pause_.setSingleShot(true);
  QObject::connect(&pause_, &QTimer::timeout, &pause_, [this] { Launch(); });
}

QtPipedProgram::~QtPipedProgram() {
  Stop();
}

void QtPipedProgram::Start(const std::vector<std::string>& words, std::chrono::milliseconds pause) {
  Stop();
  words_ = words;
  if (pause.count() > 0) {
    pause_.start(pause);
  } else {
    Launch();
  }
}

void QtPipedProgram::Launch() {
  QStringList arguments;
  for (std::size_t at = 1; at < words_.size(); ++at) {
    arguments << QString::fromStdString(words_[at]);
  }
  // The application's child: it ends with the program at the latest.
  process_ = new OwnedProcess(QCoreApplication::instance());
  process_->setProcessEnvironment(QProcessEnvironment());
  process_->setStandardErrorFile(QProcess::nullDevice());
  process_->setWorkingDirectory(QStringLiteral("/"));
  process_->setChildProcessModifier([] {
    // Handles of libraries that forgot to say that they are not for others.
    close_range(STDERR_FILENO + 1, ~0U, CLOSE_RANGE_CLOEXEC);
  });
  Listen(*process_);
  const bool isKept = kept_ != nullptr && kept_->Name() == words_.front();
  process_->start(QString::fromStdString(isKept ? kept_->Path() : words_.front()), arguments);
}

void QtPipedProgram::Listen(QProcess& process) {
  QObject::connect(&process, &QProcess::readyReadStandardOutput, &process, [this, &process] {
    const QByteArray bytes = process.readAllStandardOutput();
    if (OnOutput) {
      OnOutput({bytes.constData(), static_cast<std::size_t>(bytes.size())});
    }
  });
  QObject::connect(&process, &QProcess::finished, &process, [this](int exitCode, QProcess::ExitStatus how) {
    HasEnded(how == QProcess::NormalExit ? exitCode : Killed);
  });
  QObject::connect(
      &process, &QProcess::errorOccurred, &process,
      [this](QProcess::ProcessError error) {
        if (error == QProcess::FailedToStart) {
          HasEnded(NotStarted);
        }
      },
      Qt::QueuedConnection);
}

void QtPipedProgram::Write(std::string_view bytes) {
  if (process_ != nullptr) {
    process_->write(bytes.data(), static_cast<qint64>(bytes.size()));
  }
}

std::size_t QtPipedProgram::Unread() const {
  return process_ != nullptr ? static_cast<std::size_t>(process_->bytesToWrite()) : 0;
}

void QtPipedProgram::Stop() {
  pause_.stop();
  if (process_ != nullptr) {
    LeaveToItself(*process_);
    process_ = nullptr;
  }
}

void QtPipedProgram::HasEnded(int exitCode) {
  Stop();
  if (OnEnd) {
    OnEnd(exitCode);
  }
}
