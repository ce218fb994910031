#include "base/runtime_error.h"

namespace kora {

const char* ErrorText(int number) {
  switch (number) {
    case kBadCall: return "Bad call or argument";
    case kOverflow: return "Overflow";
    case kOutOfMemory: return "Out of memory";
    case kIndexOutOfRange: return "Index out of range";
    case kDivisionByZero: return "Division by zero";
    case kOutOfTextSpace: return "Out of text space";
    case kOutOfStack: return "Out of stack space";
    case kBadFileName: return "Bad file name or number";
    case kFileNotFound: return "File not found";
    case kDeviceError: return "Device I/O error";
    case kDiskFull: return "Disk full";
    case kBadRecordNumber: return "Bad record number";
    case kTooManyFiles: return "Too many files";
    case kDeviceNotAvailable: return "Device not available";
    case kPermissionDenied: return "Permission denied";
    case kDiskNotReady: return "Disk not ready";
    case kPathAccess: return "Path or file access error";
    case kPathNotFound: return "Path not found";
    case kInvalidValue: return "Invalid value";
    case kNoPicture: return "No room for a persistent picture";
    default: return "Application-defined error";
  }
}

RunTimeError::RunTimeError(int number) : std::runtime_error(ErrorText(number)), number_(number) {}

RunTimeError::RunTimeError(int number, const std::string& detail)
    : std::runtime_error(detail.empty() ? ErrorText(number) : detail), number_(number) {}

}  // namespace kora
