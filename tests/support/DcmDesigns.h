#pragma once
// DCM designs as the pages leave them: each sets the attributes, pin states
// and buffer records of its clock blocks the way General Setup, Clock
// Buffers and the application pages store them, so that Finish can be run on
// the result. The generation tests check the netlist of each; the HDL tool
// tests run the HDL of each through Verilator, Yosys, Icarus and GHDL.

#include "db/Tsy_WizData.h"

#include <functional>
#include <string>
#include <vector>

class Tsy_DCMwiz;

struct DcmDesign {
    std::string name;
    std::string keyword; // wizard type
    std::string part;
    std::function<void(Tsy_DCMwiz&)> setup;
};

const std::vector<DcmDesign>& DcmDesigns();
// Edits the DCMs as a design's recipe says (see DcmDesigns.cpp).
void ApplyRecipe(Tsy_DCMwiz& wizard, const std::string& recipe);

// Editing blocks as the pages do.
void Set(Tsy_Block* block, const char* attribute, const char* value);
void Use(Tsy_Block* block, const char* pin, bool on = true);
// Buffer n of an output: its type, and its row state when given.
void Buffer(Tsy_Block* block, const char* pin, int n, const char* type, const char* state = nullptr);
void PinAttr(Tsy_Block* block, const char* pin, const char* attribute, const char* value);
