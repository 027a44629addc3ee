#pragma once

#include <string>
#include <vector>

#include "core/text/StringTable.h"

/// Language of the texts, by the system's settings. Needs no QGuiApplication.
Language LanguageOfSystem();

/// Facts about the program and its system, one per line: versions of the program, the toolkit and the system;
/// the locale; each screen. Needs a QGuiApplication.
std::vector<std::string> SystemFacts();

/// A text about each screen. Needs a QGuiApplication.
std::vector<std::string> ScreenTexts();

/// Name of letters with which Chinese is written; empty if there are none. Needs a QGuiApplication.
std::string ChineseLetters();
