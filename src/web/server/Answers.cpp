#include "web/server/Answers.h"

#include <string>

namespace {

struct AnswerHeader {
  const char* Name;
  const char* Value;
};

/// Nothing but our own style and script may be loaded or asked; nothing may be sent, framed or guessed.
constexpr AnswerHeader CommonHeaders[] = {
    {"Content-Security-Policy",
     "default-src 'none'; style-src 'self'; script-src 'self'; connect-src 'self'; base-uri 'none'; "
     "form-action 'none'; frame-ancestors 'none'"},
    {"X-Content-Type-Options", "nosniff"},
    {"X-Frame-Options", "DENY"},
    {"Referrer-Policy", "no-referrer"},
    {"Cross-Origin-Resource-Policy", "same-origin"},
    {"Cache-Control", "no-cache"},
};

void ReleasePage(void* held) {
  delete static_cast<std::shared_ptr<const ServedPage>*>(held);
}

Answer WithHeaders(Answer answer) {
  for (const AnswerHeader& header : CommonHeaders) {
    MHD_add_response_header(answer.get(), header.Name, header.Value);
  }
  return answer;
}

/// Sends the bytes of the page where they are, and keeps the page until they are sent.
Answer WholePage(const std::shared_ptr<const ServedPage>& page) {
  auto held = std::make_unique<std::shared_ptr<const ServedPage>>(page);
  Answer answer(MHD_create_response_from_buffer_with_free_callback_cls(
      page->Body.size(), const_cast<char*>(page->Body.data()), &ReleasePage, held.get()));
  static_cast<void>(held.release());  // the answer's now
  MHD_add_response_header(answer.get(), MHD_HTTP_HEADER_CONTENT_TYPE, page->Type);
  MHD_add_response_header(answer.get(), MHD_HTTP_HEADER_ETAG, page->Tag.c_str());
  return WithHeaders(std::move(answer));
}

Answer UnchangedPage(const ServedPage& page) {
  Answer answer(MHD_create_response_from_buffer(0, nullptr, MHD_RESPMEM_PERSISTENT));
  MHD_add_response_header(answer.get(), MHD_HTTP_HEADER_ETAG, page.Tag.c_str());
  return WithHeaders(std::move(answer));
}

/// `text` lives as long as the program.
Answer PlainText(std::string_view text) {
  Answer answer(
      MHD_create_response_from_buffer(text.size(), const_cast<char*>(text.data()), MHD_RESPMEM_PERSISTENT));
  MHD_add_response_header(answer.get(), MHD_HTTP_HEADER_CONTENT_TYPE, "text/plain; charset=utf-8");
  return WithHeaders(std::move(answer));
}

/// True if `tag` is one of the tags in `known`, or that stands for any; a browser marks those that it
/// compares loosely by "W/".
bool IsKnown(std::string_view known, std::string_view tag) {
  return known == "*" || known.find(tag) != std::string_view::npos;
}

/// What every browser asks for by itself, and has no need of.
constexpr std::string_view IconPath = "/favicon.ico";

}  // namespace

Answers::Answers(const ServedPages& pages)
    : pages_(pages),
      nothing_(PlainText("Not found\n")),
      noIcon_(WithHeaders(Answer(MHD_create_response_from_buffer(0, nullptr, MHD_RESPMEM_PERSISTENT)))),
      otherHost_(PlainText("These pages have another address\n")),
      otherMethod_(PlainText("Pages can only be read\n")) {
  MHD_add_response_header(otherMethod_.get(), MHD_HTTP_HEADER_ALLOW, "GET, HEAD");
}

Answers::Choice Answers::For(std::string_view path, std::string_view known) {
  auto made = made_.find(path);
  if (path == IconPath) {
    return {MHD_HTTP_NO_CONTENT, noIcon_.get()};
  }
  const bool missing = made == made_.end() && pages_.Find(path) == nullptr;
  const std::string_view shown = missing ? "/missing" : path;
  if (missing) {
    made = made_.find(shown);
  }
  if (made == made_.end()) {
    const auto page = pages_.Find(shown);
    if (page == nullptr) {
      return {MHD_HTTP_NOT_FOUND, nothing_.get()};
    }
    made = made_.emplace(shown, Made{.Page = page, .Whole = WholePage(page), .Unchanged = nullptr}).first;
  }
  Made& answer = made->second;
  if (!missing && IsKnown(known, answer.Page->Tag)) {
    if (answer.Unchanged == nullptr) {
      answer.Unchanged = UnchangedPage(*answer.Page);
    }
    return {MHD_HTTP_NOT_MODIFIED, answer.Unchanged.get()};
  }
  const bool found = path != "/missing" && !missing;
  return {found ? unsigned{MHD_HTTP_OK} : unsigned{MHD_HTTP_NOT_FOUND}, answer.Whole.get()};
}
