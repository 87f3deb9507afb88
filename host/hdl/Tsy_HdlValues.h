#pragma once
// Parameter values as the two HDLs spell them. A value is first checked
// against the HDL type its primitive gives it ("string", "integer", "real",
// "hex", "bit") and brought to one canonical text, which each language then
// prints in its own syntax.

#include <string>

// True with the canonical text when the value suits the type; false with
// what the value should have been ("an integer", ...).
bool Tsy_HdlCanonicalValue(const std::string& type, const std::string& value, std::string& canonical,
                           std::string& expected);

// The value used when a library default does not suit its type.
std::string Tsy_HdlNeutralValue(const std::string& type);

// Canonical values only.
std::string Tsy_VerilogValue(const std::string& type, const std::string& canonical);
std::string Tsy_VhdlValue(const std::string& type, const std::string& canonical);

// The width of a sized hexadecimal literal ("16'h8080" is 16); 0 when the
// text is none.
int Tsy_HdlHexWidth(const std::string& canonical);
