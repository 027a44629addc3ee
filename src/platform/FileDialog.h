#pragma once

#include <string>

/// The common file dialogs.
class FileDialog {
 public:
  virtual ~FileDialog() = default;

  /// Asks for a file to open or save. `filter` is "description|pattern", for instance "XML Files |*.xml".
  /// Returns the full path chosen, or `fileName` unchanged when the operator cancels. Saving over an existing
  /// file is not questioned.
  virtual std::string ShowOpen(const std::string& filter, const std::string& fileName) = 0;
  virtual std::string ShowSave(const std::string& filter, const std::string& fileName) = 0;
};
