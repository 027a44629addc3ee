#pragma once

#include <string_view>

/// Error numbers of platform operations and conversions. The operator sees them in error reports, so a number
/// never changes its meaning.
namespace Fault {

inline constexpr int InvalidProcedureCall = 5;
inline constexpr int Overflow = 6;
inline constexpr int OutOfMemory = 7;
inline constexpr int SubscriptOutOfRange = 9;
inline constexpr int DivisionByZero = 11;
inline constexpr int TypeMismatch = 13;
inline constexpr int InternalError = 51;

// Files and devices.
inline constexpr int FileNotFound = 53;
inline constexpr int DiskFull = 61;
inline constexpr int PastEndOfFile = 62;
inline constexpr int DeviceUnavailable = 68;
inline constexpr int PermissionDenied = 70;
inline constexpr int PathAccess = 75;
inline constexpr int PathNotFound = 76;

inline constexpr int ObjectNotSet = 91;
inline constexpr int InvalidPattern = 93;
inline constexpr int InvalidFileFormat = 321;
inline constexpr int InvalidPropertyValue = 380;

// Word processor.
inline constexpr int CannotCreateObject = 429;
inline constexpr int AutomationError = 440;
inline constexpr int PrinterError = 482;

// Databases.
inline constexpr int DatabaseError = 3000;
inline constexpr int UpdateWithoutEdit = 3020;
inline constexpr int NoCurrentRecord = 3021;
inline constexpr int DuplicateKey = 3022;
inline constexpr int DatabaseNotFound = 3024;
inline constexpr int DatabaseDiskFull = 3026;
inline constexpr int DatabaseReadOnly = 3027;
inline constexpr int NoTransaction = 3034;
inline constexpr int DatabaseDiskError = 3043;
inline constexpr int DatabaseLocked = 3050;
inline constexpr int DatabaseCannotOpen = 3051;
inline constexpr int QuerySyntax = 3075;
inline constexpr int CriterionSyntax = 3077;
inline constexpr int TableNotFound = 3078;
inline constexpr int FieldReadOnly = 3164;
inline constexpr int RecordDeleted = 3167;
inline constexpr int InvalidFieldType = 3259;
inline constexpr int ItemNotFound = 3265;
inline constexpr int ValueRequired = 3314;
inline constexpr int ValueProhibited = 3317;
inline constexpr int UnrecognizedDatabase = 3343;
inline constexpr int DataConversion = 3421;

// Serial ports.
inline constexpr int InvalidPortNumber = 8002;
inline constexpr int PortAlreadyOpen = 8005;
inline constexpr int PortLost = 8012;
inline constexpr int PortNotOpen = 8018;

struct NumberedText {
  int Number;
  std::string_view Text;
};

/// The standard texts, for the numbers that have one.
inline constexpr NumberedText Texts[] = {
    {InvalidProcedureCall, "Invalid procedure call or argument"},
    {Overflow, "Overflow"},
    {OutOfMemory, "Out of memory"},
    {SubscriptOutOfRange, "Subscript out of range"},
    {DivisionByZero, "Division by zero"},
    {TypeMismatch, "Type mismatch"},
    {InternalError, "Internal error"},
    {FileNotFound, "File not found"},
    {DiskFull, "Disk full"},
    {PastEndOfFile, "Input past end of file"},
    {DeviceUnavailable, "Device unavailable"},
    {PermissionDenied, "Permission denied"},
    {PathAccess, "Path/File access error"},
    {PathNotFound, "Path not found"},
    {ObjectNotSet, "Object variable or With block variable not set"},
    {InvalidPattern, "Invalid pattern string"},
    {InvalidFileFormat, "Invalid file format"},
    {InvalidPropertyValue, "Invalid property value"},
    {AutomationError, "Automation error"},
    {PrinterError, "Printer error"},
    {UpdateWithoutEdit, "Update or CancelUpdate without AddNew or Edit."},
    {NoCurrentRecord, "No current record."},
    {NoTransaction, "You tried to commit or rollback a transaction without first beginning a transaction."},
    {RecordDeleted, "Record is deleted."},
    {ItemNotFound, "Item not found in this collection."},
    {DataConversion, "Data type conversion error."},
    {InvalidPortNumber, "Invalid port number"},
    {PortAlreadyOpen, "Port already open"},
    {PortLost, "The device is not open"},
    {PortNotOpen, "Operation valid only when the port is open"},
};

constexpr std::string_view TextOf(int number) {
  for (const NumberedText& entry : Texts) {
    if (entry.Number == number) {
      return entry.Text;
    }
  }
  return "Application-defined or object-defined error";
}

}  // namespace Fault
