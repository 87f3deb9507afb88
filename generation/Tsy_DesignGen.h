#pragma once
// The design generator run at Finish: it turns the attribute values the pages
// left on the clock blocks into a netlist of blocks, pins, nets and ports in
// the design database. One generator is made per Finish.

#include "port/StringBase.h"

#include <memory>

class Tsy_Block;
class Tsy_DCMwiz;
class Tsy_Pin;
class Tsy_Signal;
class Tsy_WizData;

class Tsy_DesignGen {
public:
    // Null when there is no design to build into.
    static std::unique_ptr<Tsy_DesignGen> Create(Tsy_DCMwiz* wizard, int wizType);
    Tsy_DesignGen(Tsy_DCMwiz* wizard, int wizType, Tsy_WizData* data);

    // Wizard types 0 to 5.
    bool GenerateDCMDesign();
    // Wizard types 6, 7 and 8.
    bool GeneratePLLDesign();
    bool GenerateDCMToPLLDesign();
    bool GeneratePLLToDCMDesign();

private:
    bool familyFlag_;
    int wizType_;
    Tsy_WizData* data_;
    Tsy_DCMwiz* wizard_;
};
