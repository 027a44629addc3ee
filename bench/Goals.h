#pragma once

#include <map>
#include <string>
#include <vector>

/// Prints one line for a goal: name, measured ratio, goal, "ok" or "short", and `detail`. Returns true when
/// it is met.
bool ReportGoal(const std::string& name, double ratio, double goal, const std::string& detail);

/// Runs all registered benchmarks, several times and interleaved at random; median real time of each by name,
/// in microseconds.
std::map<std::string, double> MedianTimes(int argc, char** argv);

double Median(std::vector<double> values);

/// "12.3 us to 45.6 us"
std::string TimesText(double microseconds, double limitMicroseconds);
