#include "app/FirstStart.h"

#include <unistd.h>

#include <QCryptographicHash>
#include <cstdio>
#include <filesystem>

#include "app/Release.h"
#include "app/StartWords.h"
#include "core/data/FirstRun.h"
#include "core/text/Filled.h"
#include "platform/qt/QtFolders.h"
#include "platform/x11/StartupNotice.h"

namespace {

std::string FromEnvironment(const char* name) {
  return qgetenv(name).toStdString();
}

InstancePlace PlaceOfThisUser() {
  std::string folder;
  QtFolders().LocalAppData(folder);
  const std::string set = FromEnvironment("XDG_RUNTIME_DIR");
  // A terminal or a timer of this user may not have it.
  const std::string runtime = set.empty() ? "/run/user/" + std::to_string(geteuid()) : set;
  return InstancePlaceOf(runtime, folder + UserDataSubfolder);
}

/// The permission to come to the front that the desktop gave this start.
std::string ActivationToken() {
  const std::string token = FromEnvironment("XDG_ACTIVATION_TOKEN");
  return token.empty() ? FromEnvironment("DESKTOP_STARTUP_ID") : token;
}

void Say(std::FILE* stream, const std::string& text) {
  std::fputs((text + '\n').c_str(), stream);
}

}  // namespace

InstancePlace InstancePlaceOf(const std::string& runtimeFolder, const std::string& dataFolder) {
  constexpr int digits = 32;
  std::error_code error;
  const std::filesystem::path canonical = std::filesystem::weakly_canonical(dataFolder, error);
  const std::string path = error ? dataFolder : canonical.string();
  const QByteArray digest =
      QCryptographicHash::hash(QByteArray::fromStdString(path), QCryptographicHash::Sha256)
          .toHex()
          .left(digits);
  return {InstanceFolders(runtimeFolder, dataFolder), ".tessarine-" + digest.toStdString()};
}

std::optional<int> FirstStart::Begin(const std::vector<std::string>& words) {
  constexpr std::chrono::seconds patience(3);
  constexpr int misused = 2;
  const StartWords asked = ReadStartWords(words);
  switch (asked.Asked) {
    case StartWords::Kind::Version:
      Say(stdout, "Tessarine " + ReleaseText());
      return 0;
    case StartWords::Kind::Help:
      Say(stdout, strings_.Text(OwnText::StartHelp));
      return 0;
    case StartWords::Kind::Unknown:
      return Refuse(Filled(strings_.Text(OwnText::StartUnknown), {asked.Word}), misused);
    case StartWords::Kind::Run:
      break;
  }
  std::error_code folderIsGone;
  file_ = asked.File.empty() ? std::string() : std::filesystem::absolute(asked.File, folderIsGone).string();
  if (folderIsGone) {
    return Bar(Filled(strings_.Text(OwnText::StartFolderGone), {asked.File}), misused);
  }
  if (!InstanceLine({file_, {}})) {
    return Bar(Filled(strings_.Text(OwnText::StartPathTooLong), {file_}), misused);
  }
  InstanceRequest request{file_, ActivationToken()};
  if (!InstanceLine(request)) {
    request.Token.clear();  // without it the window comes to the front a little later
  }
  switch (instance_.emplace(PlaceOfThisUser()).Start(request, patience)) {
    case InstanceOutcome::Told:
      EndStartupNotice(FromEnvironment("DISPLAY"), FromEnvironment("DESKTOP_STARTUP_ID"));
      return 0;
    case InstanceOutcome::NoAnswer:
      return Bar(strings_.Text(OwnText::StartUnanswered), 1);
    case InstanceOutcome::Barred:
      return Bar(Filled(strings_.Text(OwnText::StartBarred), {instance_->BarredBy()}), 1);
    case InstanceOutcome::First:
      break;
  }
  return std::nullopt;
}

int FirstStart::Bar(const std::string& text, int exitCode) {
  obstacle_ = text;
  return Refuse(text, exitCode);
}

int FirstStart::Refuse(const std::string& text, int exitCode) const {
  Say(stderr, "tessarine: " + text);
  return exitCode;
}
