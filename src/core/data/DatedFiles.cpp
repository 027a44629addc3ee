#include "core/data/DatedFiles.h"

#include <algorithm>
#include <string_view>
#include <utility>
#include <vector>

#include "platform/Letters.h"

namespace {

constexpr std::string_view DateForm = "0000-00-00-000000";

}  // namespace

std::string DatedFiles::NameAt(std::string now) const {
  std::replace(now.begin(), now.end(), ' ', '-');
  now.erase(std::remove(now.begin(), now.end(), ':'), now.end());
  return name_ + '-' + now + extension_;
}

bool DatedFiles::IsOurs(const std::string& file) const {
  std::string_view date = file;
  if (!date.starts_with(name_ + "-") || !date.ends_with(extension_)) {
    return false;
  }
  date.remove_prefix(name_.size() + 1);
  date.remove_suffix(extension_.size());
  return std::equal(date.begin(), date.end(), DateForm.begin(), DateForm.end(),
                    [](char letter, char form) { return form == '0' ? IsDigit(letter) : letter == form; });
}

void DatedFiles::DeleteOldest(const std::string& newest) const {
  std::vector<std::string> others;
  for (const std::string& file : disk_.FileNames(folder_)) {
    if (IsOurs(file) && file != newest) {
      others.push_back(file);
    }
  }
  for (std::size_t i = 0; i + most_ <= others.size(); ++i) {
    disk_.Delete(folder_ + "/" + others[i]);
  }
}
