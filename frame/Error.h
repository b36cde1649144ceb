#pragma once

#include <exception>
#include <string>
#include <string_view>

namespace tessel::frame {

/// The numbers of the errors that the library raises or passes on. A number outlives its wording: hosts and
/// applications test for the number.
namespace errors {
inline constexpr int invalidCall = 5;
inline constexpr int overflow = 6;
inline constexpr int outOfMemory = 7;
inline constexpr int subscript = 9;
inline constexpr int divisionByZero = 11;
inline constexpr int typeMismatch = 13;
inline constexpr int internal = 51;
inline constexpr int badFileName = 52;
inline constexpr int fileNotFound = 53;
inline constexpr int deviceError = 57;
inline constexpr int fileExists = 58;
inline constexpr int diskFull = 61;
inline constexpr int endOfFile = 62;
inline constexpr int permissionDenied = 70;
inline constexpr int diskNotReady = 71;
inline constexpr int pathAccess = 75;
inline constexpr int pathNotFound = 76;
inline constexpr int objectGone = 91;
inline constexpr int noSuchElement = 340;
inline constexpr int invalidValue = 380;
inline constexpr int invalidArrayIndex = 381;
inline constexpr int notAtRunTime = 382;
inline constexpr int notPermitted = 387;
inline constexpr int objectRequired = 424;
inline constexpr int noSuchMember = 438;
inline constexpr int notSupported = 445;
inline constexpr int argumentMissing = 449;
inline constexpr int wrongArguments = 450;
inline constexpr int keyInUse = 457;
inline constexpr int invalidPicture = 481;
inline constexpr int noCurrentRow = 3021;
inline constexpr int dataSourceError = 3146;
inline constexpr int noSuchField = 3265;
inline constexpr int indexOutOfBounds = 35600;
inline constexpr int elementNotFound = 35601;
inline constexpr int keyNotUnique = 35602;
}  // namespace errors

/// The standard words for a number; "Error" and the number where there are none.
std::string ErrorText(int number);

/// A numbered run-time error. A refusal carries its number alone: the words then come from `ErrorText`.
class ControlError : public std::exception {
  public:
    explicit ControlError(int number) : ControlError(number, ErrorText(number)) {}
    ControlError(int number, std::string description) : number_(number), description_(std::move(description)) {}

    int Number() const { return number_; }
    const std::string& Description() const { return description_; }
    const char* what() const noexcept override { return description_.c_str(); }

  private:
    int number_;
    std::string description_;
};

/// Success, or the number of a failure: the answer of operations that may fail inside a loop, where an exception would
/// cost too much.
class [[nodiscard]] Status {
  public:
    constexpr Status() = default;
    constexpr Status(int number) : number_(number) {}

    constexpr bool Failed() const { return number_ != 0; }
    constexpr int Number() const { return number_; }
    /// For callers for whom the failure is no normal case.
    void Check() const {
        if (Failed()) throw ControlError(number_);
    }
    friend constexpr bool operator==(Status, Status) = default;

  private:
    int number_ = 0;
};

}  // namespace tessel::frame
