#pragma once

#include <QString>

#include "platform/Folders.h"

/// The folder of the default data files for a program in `executableFolder`: that folder itself if they are
/// there (build tree), else share/tessarine beside it (installed).
QString ProgramFolder(const QString& executableFolder);

class QtFolders : public Folders {
 public:
  std::uint32_t LocalAppData(std::string& path) const override;
  std::string Program() const override;
};
