#pragma once

#include <string>
#include <vector>

/// Facts about the program and its system, one per line: versions of the program, the toolkit and the system;
/// the locale; each screen. Needs a QGuiApplication.
std::vector<std::string> SystemFacts();
