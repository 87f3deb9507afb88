#pragma once
// Names that reach the HDL must be legal identifiers of both Verilog and
// VHDL and collide with no keyword of either language.

#include <string>

// Empty when the name is fine, else why it is not ("begins with a digit" ...).
std::string Tsy_HdlNameProblem(const std::string& name);
// The name as VHDL compares it: two names that fold alike are one name.
std::string Tsy_HdlFoldCase(const std::string& name);

inline bool Tsy_IsLegalHdlName(const std::string& name)
{
    return Tsy_HdlNameProblem(name).empty();
}
