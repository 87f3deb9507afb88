#include "port/StringBase.h"

#include <algorithm>
#include <cctype>
#include <cstdio>
#include <ostream>
#include <vector>

namespace Port {

StringBase& StringBase::FormatV(const char* fmt, va_list args)
{
    va_list copy;
    va_copy(copy, args);
    int needed = std::vsnprintf(nullptr, 0, fmt, copy);
    va_end(copy);
    if (needed < 0) {
        s_.clear();
        return *this;
    }
    std::vector<char> buf(static_cast<size_t>(needed) + 1);
    std::vsnprintf(buf.data(), buf.size(), fmt, args);
    s_.assign(buf.data(), static_cast<size_t>(needed));
    return *this;
}

StringBase& StringBase::Format(const char* fmt, ...)
{
    va_list args;
    va_start(args, fmt);
    FormatV(fmt, args);
    va_end(args);
    return *this;
}

StringBase StringBase::Printf(const char* fmt, ...)
{
    StringBase out;
    va_list args;
    va_start(args, fmt);
    out.FormatV(fmt, args);
    va_end(args);
    return out;
}

static int lowerOf(char c)
{
    return std::tolower(static_cast<unsigned char>(c));
}

int StringBase::Compare(const StringBase& other, int compareType) const
{
    if (compareType != CompareNoCase)
        return s_.compare(other.s_);
    size_t n = std::min(s_.size(), other.s_.size());
    for (size_t i = 0; i < n; ++i) {
        int d = lowerOf(s_[i]) - lowerOf(other.s_[i]);
        if (d != 0)
            return d;
    }
    if (s_.size() == other.s_.size())
        return 0;
    return s_.size() < other.s_.size() ? -1 : 1;
}

StringBase& StringBase::Trim()
{
    const char* blanks = " \t";
    size_t first = s_.find_first_not_of(blanks);
    if (first == std::string::npos) {
        s_.clear();
        return *this;
    }
    size_t last = s_.find_last_not_of(blanks);
    s_ = s_.substr(first, last - first + 1);
    return *this;
}

int StringBase::GetIndexOfString(const StringBase& needle, int start) const
{
    if (start < 0 || static_cast<size_t>(start) > s_.size())
        return -1;
    size_t pos = s_.find(needle.s_, static_cast<size_t>(start));
    return pos == std::string::npos ? -1 : static_cast<int>(pos);
}

StringBase& StringBase::Truncate(size_t n)
{
    if (n < s_.size())
        s_.resize(n);
    return *this;
}

bool StringBase::StartsWith(const StringBase& prefix, int compareType) const
{
    if (prefix.GetLength() > s_.size())
        return false;
    return Left(prefix.GetLength()).Compare(prefix, compareType) == 0;
}

StringBase StringBase::Upper() const
{
    std::string out = s_;
    for (char& c : out)
        c = static_cast<char>(std::toupper(static_cast<unsigned char>(c)));
    return out;
}

StringBase& StringBase::Arg(int n, const StringBase& text)
{
    if (n < 1 || n > 9)
        return *this;
    const std::string marker = "%" + std::to_string(n);
    std::string out;
    size_t from = 0;
    for (size_t at = s_.find(marker); at != std::string::npos; at = s_.find(marker, from)) {
        out.append(s_, from, at - from);
        out += text.s_;
        from = at + marker.size();
    }
    out.append(s_, from, std::string::npos);
    s_ = std::move(out);
    return *this;
}

std::ostream& operator<<(std::ostream& os, const StringBase& s)
{
    return os << s.str();
}

} // namespace Port
