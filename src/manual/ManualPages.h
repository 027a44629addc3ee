#pragma once

#include <cstddef>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

/// One page of the operator's manual.
struct ManualPage {
  std::string Title;
  std::string Text;  ///< Markdown, its title included
};

/// A window and the titles of the page about it, one for each edition.
struct WindowPage {
  const char* Window;  ///< object name
  const char* English;
  const char* Chinese;
};

/// The manual's pages: one for each heading of the second level. What stands before the first one is left
/// out.
std::vector<ManualPage> ManualPages(std::string_view markdown);

/// Every window that the manual tells about.
const std::vector<WindowPage>& WindowPages();

/// Place of the page about the window of this name, in either edition; nothing if it has none.
std::optional<std::size_t> PageOfWindow(std::string_view window, const std::vector<ManualPage>& pages);

/// What links to a heading call it: small letters, with "-" for blanks and without punctuation.
std::string AnchorOf(std::string_view heading);

/// Place of the page that a link such as "#the-board" leads to; nothing if there is none.
std::optional<std::size_t> PageOfLink(std::string_view link, const std::vector<ManualPage>& pages);
