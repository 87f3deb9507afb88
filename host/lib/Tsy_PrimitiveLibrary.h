#pragma once
// The primitive library: every primitive a design can hold, with its pins and
// its attribute definitions (default, allowed values or range, HDL type).
// Read once from data/primitives.json.

#include "port/StringBase.h"

#include <map>
#include <memory>
#include <string>
#include <vector>

struct Tsy_AttrDef {
    std::string name;
    // "string", "integer", "real", "hex" (a sized hexadecimal literal such as
    // 16'h8080) or "bit" ("0"/"1"); wizard attributes are "string".
    std::string hdlType = "string";
    std::string defaultValue;
    // Allowed values in their offered order; a range is one "min:max" entry.
    std::vector<std::string> values;
    bool startsActive = true;
    // Whether a new template block carries the attribute from the start.
    bool onTemplate = true;
    // False for the wizard's own settings kept on a block: they are no
    // property of the primitive and never reach the HDL.
    bool hdl = true;

    // A property of the primitive that the HDL carries as a parameter.
    bool IsHdlProperty() const;
};

// Attributes named "TESY_ONLY_..." or "TSY_..." are the wizard's own: they
// follow a block through conversions and never reach the netlist.
bool Tsy_IsWizardAttributeName(const std::string& name);

struct Tsy_PinDef {
    std::string name;
    std::string direction; // "IN" or "OUT"
    int width = 1;
    bool startsActive = false;
};

struct Tsy_PrimitiveDef {
    std::string type;
    std::string description;
    std::vector<Tsy_PinDef> pins;
    std::vector<Tsy_AttrDef> attributes;

    const Tsy_AttrDef* FindAttr(const std::string& name) const;
    const Tsy_PinDef* FindPin(const std::string& name) const;
};

class Tsy_PrimitiveLibrary {
public:
    // The library of the data directory, loaded on first use. A missing or
    // malformed library throws Port::Exception naming the file and the fault.
    static const Tsy_PrimitiveLibrary& Instance();
    // Loads a library from a file (tests and tools).
    static std::unique_ptr<Tsy_PrimitiveLibrary> LoadFile(const std::string& path);

    const Tsy_PrimitiveDef* Find(const std::string& type) const;
    // The primitive whose type matches the name without regard to case
    // (VHDL names ignore case), or null.
    const Tsy_PrimitiveDef* FindNoCase(const std::string& name) const;
    std::vector<std::string> Types() const;

private:
    std::map<std::string, Tsy_PrimitiveDef> defs_;
};
