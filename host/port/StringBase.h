#pragma once
// The 8-bit string of all logic code. Qt strings appear only at the widget
// boundary; everything that crosses the platform interfaces is a StringBase.

#include <cstdarg>
#include <cstddef>
#include <iosfwd>
#include <string>

namespace Port {

enum CompareType { CompareExact = 0, CompareNoCase = 1 };

class StringBase {
public:
    StringBase() = default;
    StringBase(const char* text) : s_(text ? text : "") {}
    StringBase(const std::string& text) : s_(text) {}
    StringBase(std::string&& text) : s_(std::move(text)) {}

    const char* c_str() const { return s_.c_str(); }
    const std::string& str() const { return s_; }
    size_t GetLength() const { return s_.size(); }
    bool IsEmpty() const { return s_.empty(); }
    char operator[](size_t i) const { return i < s_.size() ? s_[i] : '\0'; }

    // printf-style formatting into this string; returns *this.
    StringBase& Format(const char* fmt, ...) __attribute__((format(printf, 2, 3)));
    StringBase& FormatV(const char* fmt, va_list args);
    // A fresh formatted string, for expressions.
    static StringBase Printf(const char* fmt, ...) __attribute__((format(printf, 1, 2)));

    // 0 when equal; CompareType 1 ignores case. Otherwise <0 / >0 like strcmp.
    int Compare(const StringBase& other, int compareType = CompareExact) const;
    bool EqualsNoCase(const StringBase& other) const { return Compare(other, CompareNoCase) == 0; }

    // Removes blanks and tabs at both ends.
    StringBase& Trim();
    // Position of the first occurrence at or after start, or -1.
    int GetIndexOfString(const StringBase& needle, int start = 0) const;
    // Keeps the first n characters.
    StringBase& Truncate(size_t n);

    StringBase Left(size_t n) const { return s_.substr(0, n); }
    StringBase Mid(size_t start) const { return start < s_.size() ? s_.substr(start) : std::string(); }
    bool StartsWith(const StringBase& prefix, int compareType = CompareExact) const;
    StringBase Upper() const;

    // Replaces the numbered placeholder "%n" (n = 1..9) by the text.
    StringBase& Arg(int n, const StringBase& text);

    StringBase& operator+=(const StringBase& other) { s_ += other.s_; return *this; }
    StringBase& operator+=(char c) { s_ += c; return *this; }
    friend StringBase operator+(StringBase a, const StringBase& b) { a += b; return a; }
    friend bool operator==(const StringBase& a, const StringBase& b) { return a.s_ == b.s_; }
    friend bool operator!=(const StringBase& a, const StringBase& b) { return a.s_ != b.s_; }
    friend bool operator<(const StringBase& a, const StringBase& b) { return a.s_ < b.s_; }

private:
    std::string s_;
};

std::ostream& operator<<(std::ostream& os, const StringBase& s);

} // namespace Port

using Port::StringBase;
