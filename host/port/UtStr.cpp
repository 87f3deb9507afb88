#include "port/UtStr.h"

#include <cerrno>
#include <climits>
#include <cmath>
#include <cstdlib>

namespace UT_STR {

int AToI(const StringBase& text)
{
    errno = 0;
    long v = std::strtol(text.c_str(), nullptr, 10);
    if (errno == ERANGE || v > INT_MAX)
        return v < 0 ? INT_MIN : INT_MAX;
    if (v < INT_MIN)
        return INT_MIN;
    return static_cast<int>(v);
}

double AToF(const StringBase& text)
{
    double v = std::strtod(text.c_str(), nullptr);
    return std::isfinite(v) ? v : 0.0;
}

bool IsDigit(char c)
{
    return c >= '0' && c <= '9';
}

bool IsAlpha(char c)
{
    return (c >= 'a' && c <= 'z') || (c >= 'A' && c <= 'Z');
}

bool ParseInt(const StringBase& text, int& out)
{
    StringBase t = text;
    t.Trim();
    if (t.IsEmpty())
        return false;
    char* end = nullptr;
    errno = 0;
    long v = std::strtol(t.c_str(), &end, 10);
    if (*end != '\0' || errno == ERANGE || v < INT_MIN || v > INT_MAX)
        return false;
    out = static_cast<int>(v);
    return true;
}

bool ParseDouble(const StringBase& text, double& out)
{
    StringBase t = text;
    t.Trim();
    if (t.IsEmpty())
        return false;
    char* end = nullptr;
    double v = std::strtod(t.c_str(), &end);
    if (*end != '\0' || !std::isfinite(v))
        return false;
    out = v;
    return true;
}

} // namespace UT_STR
