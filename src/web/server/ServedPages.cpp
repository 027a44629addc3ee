#include "web/server/ServedPages.h"

#include <cstring>
#include <utility>

#include "web/PageHash.h"

namespace {

const char* TypeOf(std::string_view path) {
  if (path.ends_with(".css")) {
    return "text/css; charset=utf-8";
  }
  if (path.ends_with(".js")) {
    return "text/javascript; charset=utf-8";
  }
  return path == "/now" ? "text/plain; charset=utf-8" : "text/html; charset=utf-8";
}

/// A name that is no longer shown shall not stay in memory.
void WipeAndDelete(ServedPage* page) {
  explicit_bzero(page->Body.data(), page->Body.size());
  delete page;
}

}  // namespace

bool ServedPages::Take(PageFrame frame) {
  if (frame.Order == PageOrder::Show) {
    return Show();
  }
  if (waiting_.size() >= MostPages || waitingBytes_ + frame.Body.size() > MostPageBytes) {
    return false;
  }
  waitingBytes_ += frame.Body.size();
  waiting_.push_back(std::move(frame));
  return true;
}

std::shared_ptr<const ServedPage> ServedPages::Find(std::string_view path) const {
  const auto found = shown_.find(path);
  return found != shown_.end() ? found->second : nullptr;
}

bool ServedPages::Show() {
  auto pages = shown_;
  std::size_t bytes = bytes_;
  for (PageFrame& frame : waiting_) {
    const auto old = pages.find(frame.Path);
    if (old != pages.end()) {
      bytes -= old->second->Body.size();
      pages.erase(old);
    }
    if (frame.Order == PageOrder::Put) {
      std::string tag = "\"";
      tag += PageHash(frame.Body);
      tag += '"';
      bytes += frame.Body.size();
      pages.emplace(frame.Path,
                    std::shared_ptr<const ServedPage>(
                        new ServedPage{.Body = std::move(frame.Body), .Tag = tag, .Type = TypeOf(frame.Path)},
                        WipeAndDelete));
    }
  }
  waiting_ = {};
  waitingBytes_ = 0;
  if (pages.size() > MostPages || bytes > MostPageBytes) {
    return false;
  }
  shown_ = std::move(pages);
  bytes_ = bytes;
  return true;
}
