#pragma once

#include <map>
#include <string>
#include <vector>

/// Prints one line for a goal: name, measured ratio, goal, "ok" or "short", and `detail`. Returns true if the
/// goal is met.
bool ReportGoal(const std::string& name, double ratio, double goal, const std::string& detail);

/// Runs all registered benchmarks several times, randomly interleaved. Returns each one's median real time in
/// microseconds, by name.
std::map<std::string, double> MedianTimes(int argc, char** argv);

double Median(std::vector<double> values);

/// "12.3 us to 45.6 us"
std::string TimesText(double microseconds, double limitMicroseconds);
