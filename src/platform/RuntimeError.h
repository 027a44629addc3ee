#pragma once

#include <stdexcept>
#include <string>

/// A failure that an operation of the platform, or a conversion, reports by number and text.
/// Numbers in use: 6 overflow, 9 subscript out of range, 11 division by zero, 13 type mismatch, 53 file not
/// found, 61 disk full, 62 past end of file, 70 permission denied, 75 path or file access error, 76 path not
/// found, 380 settings that cannot be had, 3xxx database, 8002 no such serial port, 8005 serial port in use
/// or not permitted, 8012 serial port lost, 8018 serial port not open.
class RuntimeError : public std::runtime_error {
 public:
  /// With the usual text of `number`.
  explicit RuntimeError(int number) : RuntimeError(number, TextOf(number)) {}
  RuntimeError(int number, const std::string& text) : std::runtime_error(text), number_(number) {}

  int Number() const { return number_; }

 private:
  static std::string TextOf(int number) {
    switch (number) {
      case 6:
        return "Overflow";
      case 9:
        return "Subscript out of range";
      case 11:
        return "Division by zero";
      case 13:
        return "Type mismatch";
      case 53:
        return "File not found";
      case 61:
        return "Disk full";
      case 62:
        return "Input past end of file";
      case 70:
        return "Permission denied";
      case 75:
        return "Path/File access error";
      case 76:
        return "Path not found";
      case 380:
        return "Invalid property value";
      case 3020:
        return "Update or CancelUpdate without AddNew or Edit.";
      case 3021:
        return "No current record.";
      case 3034:
        return "You tried to commit or rollback a transaction without first beginning a transaction.";
      case 3167:
        return "Record is deleted.";
      case 3265:
        return "Item not found in this collection.";
      case 8002:
        return "Invalid port number";
      case 8005:
        return "Port already open";
      case 8012:
        return "The device is not open";
      case 8018:
        return "Operation valid only when the port is open";
      default:
        return "Application-defined or object-defined error";
    }
  }

  int number_;
};
