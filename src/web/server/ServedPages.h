#pragma once

#include <cstddef>
#include <map>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

#include "web/PageStream.h"

/// A page as it is served.
struct ServedPage {
  std::string Body;
  std::string Tag;        ///< differs when the body does; in double quotes
  const char* Type = "";  ///< media type
};

/// The pages in memory. Those who still send a page keep it when it is replaced.
class ServedPages {
 public:
  /// Puts and removals wait for the next Show. Returns false, with the pages unchanged, if a limit would be
  /// passed: MostPages or MostPageBytes, for those that are shown and for those that wait.
  bool Take(PageFrame frame);

  /// Null if there is none.
  std::shared_ptr<const ServedPage> Find(std::string_view path) const;

  std::size_t Count() const { return shown_.size(); }
  std::size_t Bytes() const { return bytes_; }

 private:
  bool Show();

  std::map<std::string, std::shared_ptr<const ServedPage>, std::less<>> shown_;
  std::vector<PageFrame> waiting_;
  std::size_t waitingBytes_ = 0;
  std::size_t bytes_ = 0;
};
