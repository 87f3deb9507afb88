#pragma once
// The active netlist of a design database, resolved for the HDL writers:
// ports, wires, instances with every pin of their primitive accounted for,
// and the assignments by which an associated net drives its port. Building
// it checks everything the two languages demand (legal names, no two names
// that differ only in case, one driver per net, matching widths, typed
// parameter values), so the writers only print and never write a netlist a
// tool would refuse.

#include <set>
#include <string>
#include <vector>

class Tsy_WizData;
struct Tsy_PrimitiveDef;

struct Tsy_HdlConnection {
    enum Kind { Net, Low, High, Open };
    Kind kind = Open;
    std::string net;
};

struct Tsy_HdlPinUse {
    std::string pin;
    bool input = true;
    int width = 1;
    Tsy_HdlConnection conn;
};

struct Tsy_HdlParameter {
    std::string name;
    std::string type;  // the primitive library's HDL type
    std::string value; // canonical (Tsy_HdlValues.h)
};

struct Tsy_HdlInstance {
    std::string name;
    std::string type;
    const Tsy_PrimitiveDef* def = nullptr;
    std::vector<Tsy_HdlParameter> parameters; // in the primitive's order
    std::vector<Tsy_HdlPinUse> pins;          // every pin of the primitive, in its order
};

struct Tsy_HdlAttribute {
    std::string name;
    std::string value;
};

struct Tsy_HdlSignal {
    enum Kind { Input, Output, Wire };
    std::string name;
    Kind kind = Wire;
    int width = 1;
    // An output port that the design itself reads (an input pin or an
    // assignment takes it); VHDL needs a signal in between.
    bool readInside = false;
    std::vector<Tsy_HdlAttribute> attributes;
};

struct Tsy_HdlAssign {
    std::string target; // an output port
    std::string source;
};

struct Tsy_HdlNetlist {
    std::string module;
    std::vector<Tsy_HdlSignal> ports;          // inputs, then outputs, each by name
    std::vector<Tsy_HdlSignal> wires;          // by name
    std::vector<Tsy_HdlInstance> instances;    // in database order
    std::vector<Tsy_HdlAssign> assigns;        // by target
    std::vector<const Tsy_PrimitiveDef*> used; // the primitives instantiated, by name
    std::vector<std::string> attributeNames;   // of the signal attributes, by name

    // A name for a helper signal of a writer, based on the one given and
    // taken by nothing in the netlist or given out before (whatever the case).
    std::string FreshName(const std::string& base);

    // Every name in use, in lower case.
    std::set<std::string> taken;
};

// False with one sentence naming what is wrong when the database cannot be
// written as HDL.
bool Tsy_BuildHdlNetlist(const Tsy_WizData& data, const std::string& module, Tsy_HdlNetlist& out,
                         std::string& error);
