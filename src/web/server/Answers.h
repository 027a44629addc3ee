#pragma once

#include <microhttpd.h>

#include <map>
#include <memory>
#include <string>
#include <string_view>

#include "web/server/ServedPages.h"

/// An answer of the library, which counts who still sends it.
struct AnswerEnd {
  void operator()(MHD_Response* answer) const { MHD_destroy_response(answer); }
};
using Answer = std::unique_ptr<MHD_Response, AnswerEnd>;

/// The answers to requests for the pages, each made when it is first asked for.
class Answers {
 public:
  explicit Answers(const ServedPages& pages);

  struct Choice {
    unsigned Status;
    MHD_Response* What;  ///< belongs to this
  };

  /// `known` is the list of tags that the browser already has; empty for none.
  Choice For(std::string_view path, std::string_view known);

  /// For a browser that wants another host than this.
  Choice ForOtherHost() { return {MHD_HTTP_MISDIRECTED_REQUEST, otherHost_.get()}; }

  /// For a method that is neither GET nor HEAD.
  Choice ForOtherMethod() { return {MHD_HTTP_METHOD_NOT_ALLOWED, otherMethod_.get()}; }

  /// The pages have changed.
  void Forget() { made_.clear(); }

 private:
  struct Made {
    std::shared_ptr<const ServedPage> Page;
    Answer Whole;
    Answer Unchanged;
  };

  const ServedPages& pages_;
  std::map<std::string, Made, std::less<>> made_;
  Answer nothing_;
  Answer noIcon_;
  Answer otherHost_;
  Answer otherMethod_;
};
