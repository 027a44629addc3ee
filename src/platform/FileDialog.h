#pragma once

#include <optional>
#include <string>

/// What a file dialog shows when it opens.
struct FileRequest {
  std::string Filter;     ///< "description|pattern[|description|pattern...]", for instance "XML Files |*.xml"
  std::string Name = {};  ///< in the entry, a full path or a bare name; empty for none
  std::string Folder =
      {};  ///< empty, or one that does not exist: that of `Name`, else that of the last choice
  std::string Title = {};  ///< empty: what the toolkit calls such a dialog
};

/// The common file dialogs.
class FileDialog {
 public:
  virtual ~FileDialog() = default;

  /// Asks for a file to open, which need not exist, or to save. Returns the full path chosen; nothing when
  /// the operator cancels. Saving over an existing file is not questioned.
  virtual std::optional<std::string> ShowOpen(const FileRequest& request) = 0;
  virtual std::optional<std::string> ShowSave(const FileRequest& request) = 0;
};
