#pragma once

#include <filesystem>
#include <memory>
#include <random>
#include <string>

#include "sim/line/Device.h"
#include "sim/line/DeviceLink.h"
#include "sim/onewire/OneWireAdapter.h"

/// The devices that the operator works with: at one port a base unit or a radio modem, at another the reader
/// of buttons. Each one misbehaves in its own way until the next takes its place.
class Field {
 public:
  /// `folder` is the one that holds the program's settings; the links to the devices lie beside them.
  Field(std::filesystem::path folder, unsigned seed);

  /// Puts the next devices in the place of those that are there, which are pulled out. In turn each failure
  /// of each device has its time. Returns their names.
  std::string Change();

  /// Somebody holds a button to the reader, or takes it away.
  void TouchOrLeave();

 private:
  void ChooseDevices();
  std::unique_ptr<sim::Device> NextInstrument(std::string& name);

  std::filesystem::path folder_;
  std::mt19937 random_;
  std::size_t turn_;
  bool touched_ = false;
  std::unique_ptr<sim::Device> instrument_;
  std::unique_ptr<sim::OneWireAdapter> reader_;
  std::unique_ptr<sim::DeviceLink> instrumentLink_;
  std::unique_ptr<sim::DeviceLink> readerLink_;
};
