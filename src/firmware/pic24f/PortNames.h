#pragma once

#include <string>

#include "core/line/CommPortSetting.h"

/// The device of a port's name: "COM1" and "COM 1" are the port of that number, anything else is the path of
/// a device. Throws RuntimeError 8002 if there is no such port, 6 for a number beyond 16 bits.
std::string DeviceOfPort(const std::string& port, const CommPortSetting& setting);
