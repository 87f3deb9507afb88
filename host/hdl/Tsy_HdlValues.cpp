#include "hdl/Tsy_HdlValues.h"

#include "port/UtStr.h"

#include <cctype>
#include <charconv>
#include <cstdint>

namespace {

bool isPlainDecimal(const std::string& s)
{
    size_t i = (!s.empty() && s[0] == '-') ? 1 : 0;
    size_t digitsBefore = 0, digitsAfter = 0;
    while (i < s.size() && std::isdigit(static_cast<unsigned char>(s[i]))) {
        ++i;
        ++digitsBefore;
    }
    if (i >= s.size() || s[i] != '.')
        return false;
    ++i;
    while (i < s.size() && std::isdigit(static_cast<unsigned char>(s[i]))) {
        ++i;
        ++digitsAfter;
    }
    return i == s.size() && digitsBefore > 0 && digitsAfter > 0;
}

// Both languages need a digit on each side of the point and no exponent.
std::string decimalText(double v)
{
    char buf[400];
    auto res = std::to_chars(buf, buf + sizeof(buf), v, std::chars_format::fixed);
    std::string out = res.ec == std::errc() ? std::string(buf, res.ptr) : std::string("0");
    if (out.find('.') == std::string::npos)
        out += ".0";
    if (out == "-0.0")
        out = "0.0";
    return out;
}

int hexDigit(char c)
{
    if (c >= '0' && c <= '9')
        return c - '0';
    if (c >= 'a' && c <= 'f')
        return c - 'a' + 10;
    if (c >= 'A' && c <= 'F')
        return c - 'A' + 10;
    return -1;
}

// "<width>'h<digits>" with 1 <= width <= 64 and a value that fits the width.
bool parseHex(const std::string& s, int& width, uint64_t& value)
{
    size_t tick = s.find('\'');
    if (tick == std::string::npos || tick == 0 || tick > 2 || tick + 2 >= s.size())
        return false;
    width = 0;
    for (size_t i = 0; i < tick; ++i) {
        if (!std::isdigit(static_cast<unsigned char>(s[i])))
            return false;
        width = width * 10 + (s[i] - '0');
    }
    if (width < 1 || width > 64 || (s[tick + 1] != 'h' && s[tick + 1] != 'H'))
        return false;
    value = 0;
    for (size_t i = tick + 2; i < s.size(); ++i) {
        int d = hexDigit(s[i]);
        if (d < 0 || (value >> 60) != 0)
            return false;
        value = (value << 4) | static_cast<uint64_t>(d);
    }
    return width == 64 || (value >> width) == 0;
}

std::string hexDigits(uint64_t value, int digits)
{
    static const char kDigits[] = "0123456789ABCDEF";
    std::string out(static_cast<size_t>(digits), '0');
    for (int i = digits - 1; i >= 0; --i) {
        out[static_cast<size_t>(i)] = kDigits[value & 0xF];
        value >>= 4;
    }
    return out;
}

std::string canonicalHex(int width, uint64_t value)
{
    return std::to_string(width) + "'h" + hexDigits(value, (width + 3) / 4);
}

bool printable(const std::string& s)
{
    for (char c : s)
        if (static_cast<unsigned char>(c) < 0x20 || static_cast<unsigned char>(c) > 0x7E)
            return false;
    return true;
}

} // namespace

bool Tsy_HdlCanonicalValue(const std::string& type, const std::string& value, std::string& canonical,
                           std::string& expected)
{
    if (type == "integer") {
        int n = 0;
        expected = "a whole number";
        if (!UT_STR::ParseInt(value, n))
            return false;
        canonical = std::to_string(n);
        return true;
    }
    if (type == "real") {
        double d = 0;
        expected = "a decimal number";
        StringBase trimmed(value);
        trimmed.Trim();
        if (!UT_STR::ParseDouble(trimmed, d))
            return false;
        canonical = isPlainDecimal(trimmed.str()) ? trimmed.str() : decimalText(d);
        return true;
    }
    if (type == "hex") {
        int width = 0;
        uint64_t v = 0;
        expected = "a sized hexadecimal number such as 16'h8080";
        if (!parseHex(value, width, v))
            return false;
        canonical = canonicalHex(width, v);
        return true;
    }
    if (type == "bit") {
        expected = "0 or 1";
        if (value != "0" && value != "1")
            return false;
        canonical = value;
        return true;
    }
    expected = "text of printable characters";
    if (!printable(value))
        return false;
    canonical = value;
    return true;
}

std::string Tsy_HdlNeutralValue(const std::string& type)
{
    if (type == "integer")
        return "0";
    if (type == "real")
        return "0.0";
    if (type == "hex")
        return "1'h0";
    if (type == "bit")
        return "0";
    return std::string();
}

int Tsy_HdlHexWidth(const std::string& canonical)
{
    int width = 0;
    uint64_t v = 0;
    return parseHex(canonical, width, v) ? width : 0;
}

std::string Tsy_VerilogValue(const std::string& type, const std::string& canonical)
{
    if (type == "bit")
        return "1'b" + canonical;
    if (type == "integer" || type == "real" || type == "hex")
        return canonical;
    std::string out = "\"";
    for (char c : canonical) {
        if (c == '"' || c == '\\')
            out += '\\';
        out += c;
    }
    return out + "\"";
}

std::string Tsy_VhdlValue(const std::string& type, const std::string& canonical)
{
    if (type == "bit")
        return "'" + canonical + "'";
    if (type == "integer" || type == "real")
        return canonical;
    if (type == "hex") {
        int width = 0;
        uint64_t v = 0;
        if (!parseHex(canonical, width, v))
            return "X\"0\"";
        // A hexadecimal bit string is four bits a digit; other widths are
        // spelled bit by bit so the generic keeps its exact width.
        if (width % 4 == 0)
            return "X\"" + hexDigits(v, width / 4) + "\"";
        std::string bits(static_cast<size_t>(width), '0');
        for (int i = 0; i < width; ++i)
            if ((v >> i) & 1U)
                bits[static_cast<size_t>(width - 1 - i)] = '1';
        return "B\"" + bits + "\"";
    }
    std::string out = "\"";
    for (char c : canonical) {
        if (c == '"')
            out += '"';
        out += c;
    }
    return out + "\"";
}
