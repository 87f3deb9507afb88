#include "generation/Tsy_DesignGen.h"

#include "db/Tsy_WizData.h"
#include "wizard/Tsy_DCMwiz.h"
#include "wizard/Tsy_Family.h"

std::unique_ptr<Tsy_DesignGen> Tsy_DesignGen::Create(Tsy_DCMwiz* wizard, int wizType)
{
    if (!wizard || !wizard->GetDesignData())
        return nullptr;
    return std::make_unique<Tsy_DesignGen>(wizard, wizType, wizard->GetDesignData());
}

Tsy_DesignGen::Tsy_DesignGen(Tsy_DCMwiz* wizard, int wizType, Tsy_WizData* data)
    : familyFlag_(Tsy_Family::IsGeneration45(wizard->GetFamilyName())), wizType_(wizType), data_(data),
      wizard_(wizard)
{
}

bool Tsy_DesignGen::GenerateDCMDesign()
{
    (void)familyFlag_;
    (void)wizType_;
    (void)data_;
    return wizard_->GetActiveDCMBlk(1, true) != nullptr;
}

// The PLL designs arrive with the PLL pages; until then their wizard types
// are not offered, and a Finish of one fails.
bool Tsy_DesignGen::GeneratePLLDesign()
{
    return false;
}

bool Tsy_DesignGen::GenerateDCMToPLLDesign()
{
    return false;
}

bool Tsy_DesignGen::GeneratePLLToDCMDesign()
{
    return false;
}
