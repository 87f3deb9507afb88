#pragma once
// The HDL files of a design: the netlist as a Verilog-2001 module and as a
// self-contained VHDL-93 entity, and an instantiation template in each
// language for the designer to paste into their own design. The same
// database always gives the same bytes.

#include <string>
#include <vector>

class Tsy_PrimitiveLibrary;
class Tsy_WizData;
struct Tsy_HdlNetlist;
struct Tsy_PrimitiveDef;

struct Tsy_HdlFiles {
    std::string verilog;         // <module>.v
    std::string vhdl;            // <module>.vhd
    std::string verilogTemplate; // <module>_inst.vt
    std::string vhdlTemplate;    // <module>_inst.vht
};

// banner: lines for the comment heading every file. False with one sentence
// naming the fault when the active netlist cannot be written (see
// Tsy_BuildHdlNetlist); nothing is filled in then.
bool Tsy_WriteHdl(const Tsy_WizData& data, const std::string& module, const std::vector<std::string>& banner,
                  Tsy_HdlFiles& out, std::string& error);

// The writers proper, on a netlist already built.
std::string Tsy_WriteVerilog(Tsy_HdlNetlist& netlist, const std::vector<std::string>& banner);
std::string Tsy_WriteVhdl(Tsy_HdlNetlist& netlist, const std::vector<std::string>& banner);
std::string Tsy_WriteVerilogTemplate(const Tsy_HdlNetlist& netlist, const std::vector<std::string>& banner);
std::string Tsy_WriteVhdlTemplate(const Tsy_HdlNetlist& netlist, const std::vector<std::string>& banner);

// The VHDL component declaration of a primitive, indented by the given text.
std::string Tsy_VhdlComponent(const Tsy_PrimitiveDef& def, const std::string& indent);

// Port-level models of every primitive of the library, without behaviour:
// Verilog modules, and a VHDL package of components with an empty entity
// for each, so that HDL tools can check a generated netlist against the
// primitives' pins and parameters.
std::string Tsy_VerilogPrimitiveModels(const Tsy_PrimitiveLibrary& library);
std::string Tsy_VhdlPrimitiveModels(const Tsy_PrimitiveLibrary& library);
// The name of the VHDL package the models declare.
constexpr const char* kTsy_VhdlModelPackage = "pendra_primitives";
