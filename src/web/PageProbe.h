#pragma once

#include <cstdint>
#include <functional>
#include <string>
#include <string_view>

#include "platform/PipedProgram.h"
#include "web/PageStream.h"

/// Finds out whether the pages are answered with at their address, by a request that another program makes.
/// Nothing here waits.
class PageProbe {
 public:
  /// `path` is that of the program that serves the pages, which also asks for them. `program` must outlive
  /// this.
  PageProbe(PipedProgram& program, std::string path);
  ~PageProbe();
  PageProbe(const PageProbe&) = delete;
  PageProbe& operator=(const PageProbe&) = delete;

  /// Called after each change of Answered.
  std::function<void()> OnChange;

  /// Asks. Where the last request is still without an answer, there counts as none.
  void Ask(const std::string& address, std::uint16_t port);

  /// The pages are no longer there.
  void Forget();

  /// True from an answer on until a request stays without one.
  bool Answered() const { return answered_; }

 private:
  void TakeReports(std::string_view bytes);
  void Become(bool answered);

  PipedProgram& program_;
  std::string path_;
  PageReportReader reports_;
  bool asking_ = false;
  bool answered_ = false;
};
