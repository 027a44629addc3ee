#pragma once

#include <functional>
#include <string>
#include <vector>

/// Joins the PDF files `parts` into one at `target`, in their order, calling `onProgress` now and then.
/// Throws RuntimeError 75 if a part cannot be read or the target cannot be written; no partial file is left.
void JoinPdfs(const std::vector<std::string>& parts, const std::string& target,
              const std::function<void()>& onProgress);
