#pragma once

#include <stdexcept>
#include <string>

namespace kora {

// The run-time failures that the system tells apart. The numbers show in messages.
enum ErrorNumber : int {
  kBadCall = 5,
  kOverflow = 6,
  kOutOfMemory = 7,
  kIndexOutOfRange = 9,
  kDivisionByZero = 11,
  kOutOfTextSpace = 14,
  kOutOfStack = 28,
  kBadFileName = 52,
  kFileNotFound = 53,
  kDeviceError = 57,
  kDiskFull = 61,
  kBadRecordNumber = 63,
  kTooManyFiles = 67,
  kDeviceNotAvailable = 68,
  kPermissionDenied = 70,
  kDiskNotReady = 71,
  kPathAccess = 75,
  kPathNotFound = 76,
  kInvalidValue = 380,
  kNoPicture = 480,
};

// The standing text of a number: "Overflow" for 6. "Application-defined error" for others.
const char* ErrorText(int number);

// Thrown by low routines. Each operation has one handler, at the place where the user asked
// for the work, which turns the number into the operation's own message.
class RunTimeError : public std::runtime_error {
 public:
  explicit RunTimeError(int number);
  // `detail` is the host's own text, such as "No space left on device".
  RunTimeError(int number, const std::string& detail);

  int number() const { return number_; }

 private:
  int number_;
};

}  // namespace kora
