#pragma once

#include "port/StringBase.h"

#include <exception>

namespace Port {

class Exception : public std::exception {
public:
    explicit Exception(StringBase message) : message_(std::move(message)) {}
    const char* what() const noexcept override { return message_.c_str(); }
    const StringBase& GetMessage() const { return message_; }

private:
    StringBase message_;
};

} // namespace Port

namespace Util {

class IllegalMethodCalledException : public Port::Exception {
public:
    using Port::Exception::Exception;
};

} // namespace Util
