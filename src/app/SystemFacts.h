#pragma once

#include <string>
#include <vector>

/// What the program is and runs on, a line each: versions of the program, the toolkit and the system; the
/// locale; each screen. Needs a QGuiApplication.
std::vector<std::string> SystemFacts();
