// Errors raised by the controls and by the platforms they run on.
//
// Every failure that reaches a host is an exception derived from ryx::Error, with a message
// that says which value was wrong and why. Only the loading of saved properties swallows
// them, one key at a time.
#pragma once

#include <stdexcept>
#include <string>

namespace ryx {

class Error : public std::runtime_error {
  public:
    using std::runtime_error::runtime_error;
};

// A number does not fit the 8-, 16- or 32-bit field it is meant for, or a text is too long.
class OverflowError : public Error {
  public:
    using Error::Error;
};

// A value of the wrong kind: a text that is not a number, an array where a colour belongs.
class TypeMismatchError : public Error {
  public:
    using Error::Error;
};

// An index that names no widget or row (an Index other than 0 or 1, say).
class IndexError : public Error {
  public:
    using Error::Error;
};

// A widget refused an operation (focus given to a hidden box, for one).
class WidgetError : public Error {
  public:
    using Error::Error;
};

// The agency database could not be opened or read.
class DataSourceError : public Error {
  public:
    using Error::Error;
};

// A form file that cannot be read or written as a whole.
class FormFileError : public Error {
  public:
    using Error::Error;
};

}  // namespace ryx
