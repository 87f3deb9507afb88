#pragma once
// Number and character helpers. They never throw and never read past the
// text: malformed numbers read as far as they are numbers, and as 0 otherwise.

#include "port/StringBase.h"

namespace UT_STR {

int AToI(const StringBase& text);
double AToF(const StringBase& text);
bool IsDigit(char c);
bool IsAlpha(char c);

// Strict reading for option and file values: the whole text must be a number.
bool ParseInt(const StringBase& text, int& out);
bool ParseDouble(const StringBase& text, double& out);

} // namespace UT_STR
