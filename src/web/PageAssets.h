#pragma once

#include <string>

/// The pages' style sheet.
std::string PageStyle();

/// The pages' script. On the front page it asks every 3 s whether there is another board, and shows it; on
/// other pages it then shows the link to it. Pages work without it.
std::string PageScript();
