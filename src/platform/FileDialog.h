#pragma once

#include <optional>
#include <string>

/// What a file dialog shows when it opens.
struct FileRequest {
  std::string Filter;     ///< "description|pattern[|description|pattern...]", for instance "XML Files |*.xml"
  std::string Name = {};  ///< shown in the name entry: a full path, a bare name, or empty
  std::string Folder =
      {};  ///< empty, or one that does not exist: that of `Name`, else that of the last choice
  std::string Title = {};  ///< empty: the toolkit's own title
};

/// The common file dialogs.
class FileDialog {
 public:
  virtual ~FileDialog() = default;

  /// Asks for a file to open, which need not exist, or to save. Returns the full path chosen, or nothing if
  /// the operator cancels. Does not ask before overwriting an existing file.
  virtual std::optional<std::string> ShowOpen(const FileRequest& request) = 0;
  virtual std::optional<std::string> ShowSave(const FileRequest& request) = 0;

  /// Asks for an existing folder. Of the request, only folder and title are used. Otherwise like ShowOpen.
  virtual std::optional<std::string> ShowFolder(const FileRequest& request) = 0;
};
