#include <unistd.h>

#include <QApplication>
#include <QMessageBox>
#include <QTimer>

#include "app/FirstStart.h"
#include "app/Program.h"
#include "app/SystemFacts.h"
#include "ui/Look.h"

namespace {

/// True where somebody may look at a window of this process, but not at its standard error.
bool NeedsWindow() {
  const bool hasDisplay =
      qEnvironmentVariableIsSet("DISPLAY") || qEnvironmentVariableIsSet("WAYLAND_DISPLAY");
  return hasDisplay && !qgetenv("QT_QPA_PLATFORM").startsWith("offscreen") && isatty(STDERR_FILENO) == 0;
}

/// For a while only: nobody has to answer it.
void ShowBriefly(int argc, char** argv, const std::string& text, Language language) {
  constexpr int milliseconds = 10'000;
  QApplication application(argc, argv);
  QTranslator dialogTexts;
  UseDialogTexts(dialogTexts, language);
  PrepareLook();
  QMessageBox box(QMessageBox::Warning, QStringLiteral("Tessarine"), QString::fromStdString(text),
                  QMessageBox::Ok);
  QTimer::singleShot(milliseconds, &box, &QDialog::accept);
  box.exec();
}

}  // namespace

int main(int argc, char** argv) {
  const StringTable strings(LanguageOfSystem());
  FirstStart start(strings);
  if (const std::optional<int> exitCode = start.Begin({argv + 1, argv + argc})) {
    if (!start.Obstacle().empty() && NeedsWindow()) {
      ShowBriefly(argc, argv, start.Obstacle(), strings.TextLanguage());
    }
    return *exitCode;
  }
  QApplication application(argc, argv);
  Program program;
  program.Listen(start.Listener());
  if (!start.File().empty()) {
    program.Window().Open(start.File());
  }
  return program.Run();
}
