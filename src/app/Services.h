#pragma once

#include <functional>
#include <memory>
#include <string>

#include "core/text/StringTable.h"
#include "platform/Clock.h"
#include "platform/Computer.h"
#include "platform/Database.h"
#include "platform/EventPump.h"
#include "platform/FileDialog.h"
#include "platform/Files.h"
#include "platform/Folders.h"
#include "platform/LocalAddresses.h"
#include "platform/MessageBoxes.h"
#include "platform/MonotonicClock.h"
#include "platform/OldDatabases.h"
#include "platform/OneWire.h"
#include "platform/PipedProgram.h"
#include "platform/Programs.h"
#include "platform/SerialDevices.h"
#include "platform/SerialPort.h"
#include "platform/SoundConverter.h"
#include "platform/SoundPlayer.h"
#include "platform/WakeLock.h"
#include "platform/WordProcessor.h"

/// The platform services that the main window uses; they must outlive it.
struct Services {
  const StringTable& Strings;
  const Clock& Time;
  DatabaseEngine& Databases;
  OldDatabases& Old;
  EventPump& Events;
  const MonotonicClock& Elapsed;
  FileDialog& CommonDialog1;
  Files& Disk;
  const Folders& Places;
  MessageBoxes& Boxes;
  Programs& OtherPrograms;
  const SerialDevices& Devices;
  SerialPort& MSComm1;
  ::WordProcessor& WordProcessor;
  /// Turns a picture file as the camera noted in it.
  std::function<std::string(const std::string& bytes)> UprightPicture;
  WakeLock& Awake;
  SerialPort& SoundPort;  ///< the sound recorder's own, on the device of the settings
  ::SoundPlayer& SoundPlayer;
  const ::SoundConverter& SoundConverter;
  const LocalAddresses& Addresses;
  /// Makes a program that is started and heard later.
  std::function<std::unique_ptr<PipedProgram>()> MakePipedProgram;
  std::string ResultsProgram;  ///< path of the one that serves the results page
  /// Waits for a membership button and returns its number, or NoDallasId. Empty if there is no reader.
  std::function<std::string()> ButtonSwipe = {};
  /// The bus behind the reader; null if there is none.
  OneWire* Wire = nullptr;
  /// Opens the archive of games. It does not wait long for a locked file; null for one that does.
  DatabaseEngine* Archives = nullptr;
  /// This computer; without it there is no System Check.
  const ::Computer* Computer = nullptr;
  /// Another text for each version of the program; where it is empty, versions are neither remembered nor
  /// told.
  std::string Release = {};
};
