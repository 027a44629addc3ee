#pragma once

#include <functional>
#include <string>

#include "core/text/StringTable.h"
#include "platform/Clock.h"
#include "platform/Database.h"
#include "platform/EventPump.h"
#include "platform/FileDialog.h"
#include "platform/Files.h"
#include "platform/Folders.h"
#include "platform/MessageBoxes.h"
#include "platform/OldDatabases.h"
#include "platform/Programs.h"
#include "platform/SerialDevices.h"
#include "platform/SerialPort.h"
#include "platform/WordProcessor.h"

/// The platform services that the main window uses; they must outlive it.
struct Services {
  const StringTable& Strings;
  const Clock& Time;
  DatabaseEngine& Databases;
  OldDatabases& Old;
  EventPump& Events;
  FileDialog& CommonDialog1;
  Files& Disk;
  const Folders& Places;
  MessageBoxes& Boxes;
  Programs& OtherPrograms;
  const SerialDevices& Devices;
  SerialPort& MSComm1;
  ::WordProcessor& WordProcessor;
  /// Waits for a membership button and returns its number, or NoDallasId. Empty if there is no reader.
  std::function<std::string()> ButtonSwipe = {};
};
